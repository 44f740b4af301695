#include "cli/Amounts.h"

#include <charconv>
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

} // namespace pallax
