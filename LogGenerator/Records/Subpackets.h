#pragma once

#include "LogGenerator/Records/LogRecord.h"

#include <cstdint>
#include <optional>

namespace pallax {

/// The subpacket with that id in a packet of subpackets: the view from its first byte to the
/// packet's end, no matter which size it claims. Nothing when there is none.
///
///   byte  width  field
///   14    8      number of subpackets
///   17           the first one
///
///   a subpacket, from its start
///   0     8      id
///   2     16     size in bytes, this header included: where the next one starts
///
/// A subpacket that ends 17 bytes or more past the packet's end is logged as an error and ends the
/// search.
std::optional<LogRecord> findSubpacket(const LogRecord& packet, std::uint8_t id);

/// The least length of a packet of subpackets.
inline constexpr std::size_t kSubpacketsStart = 17;

} // namespace pallax
