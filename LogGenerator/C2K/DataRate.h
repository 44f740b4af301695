#pragma once

#include "LogGenerator/Records/Layout.h"
#include "plist/PropertyList.h"

#include <cstdint>
#include <span>
#include <string_view>

namespace pallax {

/// Under which names a link's running values are kept between packets.
struct DataRateNames {
    std::string_view sequence; ///< state key: the last packet's sequence number
    std::string_view sent;     ///< state key: the last packet's total
    /// Keys of the state's "ExtraInfo": the values just stored, and those of the packet before.
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

/// The rate since the link's last packet, in kbps: what has been sent meanwhile per 1024 steps of
/// the sequence number, which is 32 bits wide and wraps. Null, so that the rate stays as it is,
/// when the sequence number has not grown; it is negative when the total has fallen, and empty
/// after the first packet. Then keeps the new values.
PropertyList dataRateSince(const DataRateNames& names, std::uint32_t sequence, std::int64_t sent,
                           Dictionary& state);

/// What the counters add up to that the packet holds whole, each with its weight.
std::int64_t weightedSum(std::span<const Counter> counters, const LogRecord& packet);

} // namespace pallax
