#pragma once

#include <cstdint>
#include <string>

namespace pallax {

/// "1 packet", "2 packets".
inline std::string counted(std::uint64_t count, const std::string& thing) {
    return std::to_string(count) + " " + thing + (count == 1 ? "" : "s");
}

} // namespace pallax
