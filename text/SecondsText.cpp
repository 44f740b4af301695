#include "text/SecondsText.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <system_error>

namespace pallax {

Result<std::chrono::nanoseconds, std::string> parseSeconds(const std::string& text) {
    constexpr double kMost = 1e9; // about 30 years
    double seconds = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, seconds);
    if (result.ec == std::errc::invalid_argument || result.ptr != end || std::isnan(seconds)) {
        return "\"" + text + "\" is not a number of seconds";
    }
    if (result.ec != std::errc() || seconds <= 0 || seconds > kMost) {
        return "\"" + text + "\" is out of range, which is above 0 and up to 1000000000";
    }
    const std::chrono::duration<double> duration(seconds);
    return std::max(std::chrono::duration_cast<std::chrono::nanoseconds>(duration),
                    std::chrono::nanoseconds(1));
}

Result<std::chrono::nanoseconds, std::string> parseSecondsWithUnit(std::string text) {
    if (text.size() > 1 && text.ends_with('s')) {
        text.pop_back();
    }
    return parseSeconds(text);
}

} // namespace pallax
