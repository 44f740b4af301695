#include "text/KeyValues.h"

#include "text/Format.h"

#include <algorithm>

namespace pallax {

namespace {

std::optional<std::string> takeLine(std::string_view line, const TakeKeyValue& take) {
    if (line.empty() || line.front() == '#') {
        return std::nullopt;
    }
    const std::size_t equals = line.find('=');
    if (equals == std::string_view::npos) {
        return "a setting is written \"key = value\"";
    }
    return take(trimmed(line.substr(0, equals)), trimmed(line.substr(equals + 1)));
}

} // namespace

std::string_view trimmed(std::string_view text) {
    constexpr std::string_view kBlanks = " \t\r";
    const std::size_t start = text.find_first_not_of(kBlanks);
    if (start == std::string_view::npos) {
        return {};
    }
    return text.substr(start, text.find_last_not_of(kBlanks) - start + 1);
}

std::optional<std::string> readKeyValues(std::string_view text, std::string_view file,
                                         const TakeKeyValue& take) {
    for (int number = 1; !text.empty(); ++number) {
        const std::string_view line = text.substr(0, text.find('\n'));
        text.remove_prefix(std::min(line.size() + 1, text.size()));
        if (const auto reason = takeLine(trimmed(line), take)) {
            return formatText("%@, line %d: %@.", {file, number, *reason});
        }
    }
    return std::nullopt;
}

} // namespace pallax
