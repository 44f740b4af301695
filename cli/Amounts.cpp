#include "cli/Amounts.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>
#include <string_view>
#include <system_error>

namespace pallax {

Result<std::uint64_t, std::string> parseSize(const std::string& text) {
    constexpr std::string_view kUnits = "kMG"; // each 1024 times the one before
    constexpr unsigned kBitsPerUnit = 10;
    std::uint64_t number = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number);
    const std::string_view rest(result.ptr, static_cast<std::size_t>(end - result.ptr));
    const std::size_t unit = rest.size() == 1 ? kUnits.find(rest.front()) : kUnits.npos;
    if (result.ec == std::errc::invalid_argument || (!rest.empty() && unit == kUnits.npos)) {
        return "\"" + text + "\" is not a size such as 4096, 64k, 100M or 2G";
    }
    const auto shift = rest.empty() ? 0U : kBitsPerUnit * static_cast<unsigned>(unit + 1);
    if (result.ec != std::errc() || number == 0 ||
        number > std::numeric_limits<std::uint64_t>::max() >> shift) {
        return "\"" + text + "\" is out of range, which is from 1 to 17179869183G";
    }
    return number << shift;
}

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

} // namespace pallax
