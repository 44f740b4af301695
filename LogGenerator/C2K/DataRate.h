#pragma once

#include "LogGenerator/Records/Description.h"
#include "plist/PropertyList.h"

#include <cstdint>
#include <string_view>

namespace pallax {

/// Under which names a link's running values are kept between packets and its rate is shown.
struct DataRateNames {
    std::string_view rate;     ///< lookup name
    std::string_view sequence; ///< state key: the last packet's sequence number
    std::string_view sent;     ///< state key: the last packet's total
    /// Keys of the state's "ExtraInfo": the values just stored, and those of the packet before.
    std::string_view sequenceNow;
    std::string_view sentNow;
    std::string_view sequenceBefore;
    std::string_view sentBefore;
};

/// Shows the rate since the link's last packet, in kbps: what has been sent meanwhile per 1024
/// steps of the sequence number, which is 32 bits wide and wraps. The rate stays as it is when the
/// sequence number has not grown; it is negative when the total has fallen, and empty after the
/// first packet. Then keeps the new values.
void updateDataRate(const DataRateNames& names, std::uint32_t sequence, std::int64_t sent,
                    Dictionary& state, const Dictionary& lookup);

/// A rate that is shown so: the packet's sequence number, and its counters with the bytes of all.
FieldDescription describeDataRate(const DataRateNames& names, const Position& sequence,
                                  const Extent& bytes, std::vector<Counter> counters);

} // namespace pallax
