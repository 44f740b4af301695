#pragma once

#include <cstdint>
#include <map>
#include <string>

namespace pallax {

/// What has been masked, in numbers.
struct MaskReport {
    std::uint64_t packets = 0; ///< and displays of snapshots
    std::uint64_t values = 0;  ///< that were replaced
    /// Packets that cannot be understood, and other parts of a file that may hold anything.
    std::uint64_t unknownPackets = 0;
    std::uint64_t unknownParts = 0;

    /// "2400 packets, 3 values masked; 1 packet that cannot be understood zeroed"
    std::string text(bool keepsUnknown) const;
};

} // namespace pallax
