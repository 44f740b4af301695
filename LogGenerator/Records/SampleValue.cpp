#include "LogGenerator/Records/SampleValue.h"

#include <charconv>
#include <cstddef>
#include <system_error>

namespace pallax {

namespace {

bool isDigit(char character) {
    return character >= '0' && character <= '9';
}

/// The unit in the text after a number: one word after a blank, or a per cent sign. Nothing for
/// other texts.
std::optional<std::string_view> unitIn(std::string_view rest) {
    if (rest.empty() || rest == "%") {
        return rest;
    }
    if (rest.size() < 2 || rest.front() != ' ' || isDigit(rest[1]) ||
        rest.find_first_of(" +-,;:()", 1) != std::string_view::npos) {
        return std::nullopt;
    }
    return rest.substr(1);
}

/// A number without a sign at the beginning of a text.
struct Unsigned {
    double number;
    std::size_t length;
};

/// Most numbers are whole and short. Reading these here takes a third of what std::from_chars
/// takes, which is 2 % of the indexing of an object stream.
std::optional<Unsigned> unsignedIn(std::string_view text) {
    constexpr std::size_t kExactDigits = 15; // of a double
    std::size_t length = 0;
    std::uint64_t whole = 0;
    for (; length < text.size() && isDigit(text[length]); ++length) {
        whole = whole * 10 + static_cast<std::uint64_t>(text[length] - '0');
    }
    const bool hasFraction = length < text.size() && text[length] == '.';
    if (length > 0 && length <= kExactDigits && !hasFraction) {
        return Unsigned{static_cast<double>(whole), length};
    }
    if (length == 0) {
        return std::nullopt; // std::from_chars also takes "inf" and "nan"
    }
    const char* const end = text.data() + text.size();
    double number = 0.0;
    const auto read = std::from_chars(text.data(), end, number, std::chars_format::fixed);
    return read.ec == std::errc()
               ? std::optional(Unsigned{number, static_cast<std::size_t>(read.ptr - text.data())})
               : std::nullopt;
}

} // namespace

std::optional<NumberText> numberTextIn(std::string_view text) {
    const std::size_t sign = !text.empty() && (text[0] == '-' || text[0] == '+') ? 1 : 0;
    const auto read = unsignedIn(text.substr(sign));
    const auto unit = read ? unitIn(text.substr(sign + read->length)) : std::nullopt;
    if (!unit) {
        return std::nullopt;
    }
    return NumberText{text, text[0] == '-' ? -read->number : read->number, *unit};
}

} // namespace pallax
