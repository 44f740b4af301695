#include "ui/terminal/TextWidth.h"

#include "platform/Utf8.h"

#include <algorithm>
#include <clocale>
#include <cwchar>
#include <locale.h> // NOLINT(modernize-deprecated-headers): POSIX has more in it than C
#include <utility>

namespace pallax::terminal {

namespace {

constexpr std::string_view kReplacement = "\xEF\xBF\xBD"; // U+FFFD

/// The calling thread's character type is UTF-8's for a scope, whatever the user's locale is.
class Utf8CharacterType {
public:
    Utf8CharacterType() : _previous(::uselocale(utf8())) {}
    ~Utf8CharacterType() { ::uselocale(_previous); }
    Utf8CharacterType(const Utf8CharacterType&) = delete;
    Utf8CharacterType& operator=(const Utf8CharacterType&) = delete;

private:
    /// The C library carries this locale in itself. Kept for the life of the process.
    static locale_t utf8() {
        static locale_t locale = ::newlocale(LC_CTYPE_MASK, "C.UTF-8", nullptr);
        return locale;
    }

    locale_t _previous;
};

/// Marks that would turn the direction of all that follows on the row.
bool turnsDirection(char32_t codePoint) {
    return (codePoint >= 0x202A && codePoint <= 0x202E) ||
           (codePoint >= 0x2066 && codePoint <= 0x2069);
}

/// -1 for what cannot be shown.
int columnsOfCodePoint(char32_t codePoint) {
    constexpr char32_t kFirstPrintable = 0x20;
    constexpr char32_t kDelete = 0x7F;
    if (codePoint < kDelete) {
        return codePoint < kFirstPrintable ? -1 : 1;
    }
    if (turnsDirection(codePoint)) {
        return -1;
    }
    return ::wcwidth(static_cast<wchar_t>(codePoint));
}

bool isPlainAscii(std::string_view text) {
    return std::all_of(text.begin(), text.end(),
                       [](char byte) { return byte >= ' ' && byte < 0x7F; });
}

} // namespace

std::vector<Cluster> clustersOf(std::string_view text) {
    const Utf8CharacterType utf8;
    std::vector<Cluster> clusters;
    clusters.reserve(text.size());
    for (std::size_t at = 0; at < text.size();) {
        const Utf8CodePoint codePoint = utf8At(text, at);
        const std::size_t size = std::max<std::size_t>(codePoint.size, 1);
        const int columns = codePoint.size == 0 ? -1 : columnsOfCodePoint(codePoint.value);
        if (columns < 0) {
            clusters.push_back({std::string(kReplacement), 1, at, size});
        } else if (columns > 0) {
            clusters.push_back({std::string(text.substr(at, size)), columns, at, size});
        } else if (clusters.empty()) {
            clusters.push_back({std::string(1, ' ').append(text.substr(at, size)), 1, at, size});
        } else {
            clusters.back().text += text.substr(at, size);
            clusters.back().bytes += size;
        }
        at += size;
    }
    return clusters;
}

int columnsOf(std::string_view text) {
    if (isPlainAscii(text)) {
        return static_cast<int>(text.size());
    }
    int columns = 0;
    for (const Cluster& cluster : clustersOf(text)) {
        columns += cluster.columns;
    }
    return columns;
}

} // namespace pallax::terminal
