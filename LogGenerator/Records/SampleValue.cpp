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

} // namespace

std::optional<NumberText> numberTextIn(std::string_view text) {
    const std::size_t sign = !text.empty() && (text[0] == '-' || text[0] == '+') ? 1 : 0;
    if (text.size() == sign || !isDigit(text[sign])) {
        return std::nullopt; // from_chars also takes "inf" and "nan"
    }
    const char* const start = text.data() + sign;
    const char* const end = text.data() + text.size();
    double number = 0.0;
    const auto read = std::from_chars(start, end, number, std::chars_format::fixed);
    if (read.ec != std::errc()) {
        return std::nullopt;
    }
    const auto unit = unitIn({read.ptr, static_cast<std::size_t>(end - read.ptr)});
    if (!unit) {
        return std::nullopt;
    }
    return NumberText{text, text[0] == '-' ? -number : number, *unit};
}

} // namespace pallax
