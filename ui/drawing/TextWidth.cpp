#include "ui/drawing/TextWidth.h"

#include "text/Printable.h"
#include "text/Utf8.h"

#include <algorithm>
#include <clocale>
#include <cwchar>
#include <locale.h> // NOLINT(modernize-deprecated-headers): POSIX has more in it than C
#include <utility>

namespace pallax::terminal {

namespace {

/// Sets the calling thread's character type to UTF-8 for a scope, in any locale.
class Utf8CharacterType {
public:
    Utf8CharacterType() : _previous(::uselocale(utf8())) {}
    ~Utf8CharacterType() { ::uselocale(_previous); }
    Utf8CharacterType(const Utf8CharacterType&) = delete;
    Utf8CharacterType& operator=(const Utf8CharacterType&) = delete;

private:
    /// This locale is built into the C library. Kept until the process ends.
    static locale_t utf8() {
        static locale_t locale = ::newlocale(LC_CTYPE_MASK, "C.UTF-8", nullptr);
        return locale;
    }

    locale_t _previous;
};

/// The width of a character that does not command the terminal; -1 for an unprintable one.
int columnsOfCodePoint(char32_t codePoint) {
    constexpr char32_t kFirstBeyondAscii = 0x80;
    return codePoint < kFirstBeyondAscii ? 1 : ::wcwidth(static_cast<wchar_t>(codePoint));
}

bool isPlainAscii(std::string_view text) {
    return std::all_of(text.begin(), text.end(),
                       [](char byte) { return byte >= ' ' && byte < 0x7F; });
}

/// Adds a cluster for each character of the escape, all with the same source bytes.
void addEscape(std::vector<Cluster>& clusters, char32_t codePoint, std::size_t at,
               std::size_t size) {
    std::string escape;
    appendEscape(escape, codePoint);
    for (const char character : escape) {
        clusters.push_back({std::string(1, character), 1, at, size});
    }
}

} // namespace

std::vector<Cluster> clustersOf(std::string_view text) {
    const Utf8CharacterType utf8;
    std::vector<Cluster> clusters;
    clusters.reserve(text.size());
    bool canCombine = false; // with the last cluster
    for (std::size_t at = 0; at < text.size();) {
        const Utf8CodePoint codePoint = utf8At(text, at);
        const std::size_t size = std::max<std::size_t>(codePoint.size, 1);
        const bool isEscaped = codePoint.size > 0 && commandsTerminal(codePoint.value);
        const int columns = codePoint.size == 0 ? -1 : columnsOfCodePoint(codePoint.value);
        if (isEscaped) {
            addEscape(clusters, codePoint.value, at, size);
        } else if (columns < 0) {
            clusters.push_back({std::string(kReplacementCharacter), 1, at, size});
        } else if (columns > 0) {
            clusters.push_back({std::string(text.substr(at, size)), columns, at, size});
        } else if (!canCombine) {
            clusters.push_back({std::string(1, ' ').append(text.substr(at, size)), 1, at, size});
        } else {
            clusters.back().text += text.substr(at, size);
            clusters.back().bytes += size;
        }
        canCombine = !isEscaped;
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

std::vector<std::string> wrappedText(std::string_view text, int columns) {
    std::vector<std::string> lines(1);
    while (!text.empty()) {
        const std::size_t end = std::min(text.find(' '), text.size());
        const std::string_view word = text.substr(0, end);
        text.remove_prefix(std::min(end + 1, text.size()));
        std::string& line = lines.back();
        if (line.empty()) {
            line = word;
        } else if (columnsOf(line) + 1 + columnsOf(word) <= columns) {
            line.append(1, ' ').append(word);
        } else {
            lines.emplace_back(word);
        }
    }
    return lines;
}

} // namespace pallax::terminal
