#pragma once

#include <cstdint>

namespace pallax {

/// An effective log code: the 16-bit code of a record, or `kExtendedLogCodes` OR the code for a
/// record of the telephony service's extra set.
using LogCode = std::uint32_t;

inline constexpr LogCode kExtendedLogCodes = 0xFF0000;

/// The extra records that carry a serialized property list after the header.
inline constexpr LogCode kSimFilesLogCode = 0xFF0000;
inline constexpr LogCode kCellMonitorLogCode = 0xFF0001;
inline constexpr LogCode kPDPContextsLogCode = 0xFF0002;

} // namespace pallax
