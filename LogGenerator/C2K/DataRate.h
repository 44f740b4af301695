#pragma once

#include "LogGenerator/Records/Layout.h"
#include "plist/PropertyList.h"

#include <cstdint>
#include <span>
#include <string_view>

namespace pallax {

/// The names of a link's running values in the state.
struct DataRateNames {
    std::string_view sequence; ///< state key: the sequence number of the last packet
    std::string_view sent;     ///< state key: the total of the last packet
    /// Keys of the state's "ExtraInfo": the new values, and those of the packet before.
    std::string_view sequenceNow;
    std::string_view sentNow;
    std::string_view sequenceBefore;
    std::string_view sentBefore;
};

inline constexpr NumberFormat kDataRateFormat{"%.2f kbps"};
inline constexpr std::string_view kDataRateFormula =
    "growth of the weighted sum of the counters since the packet before, divided by 1024 x the "
    "growth of the sequence number; empty at the first packet, unchanged where the number has not "
    "grown";

/// The rate since the link's last packet in kbps: the growth of the total per 1024 steps of the
/// sequence number, which has 32 bits and wraps. Null (the shown rate does not change) if the
/// sequence number has not grown, negative if the total has fallen, and empty after the first
/// packet. Then stores the new values.
PropertyList dataRateSince(const DataRateNames& names, std::uint32_t sequence, std::int64_t sent,
                           Dictionary& state);

/// The sum of the counters that are whole in the packet, each with its weight.
std::int64_t weightedSum(std::span<const Counter> counters, const LogRecord& packet);

} // namespace pallax
