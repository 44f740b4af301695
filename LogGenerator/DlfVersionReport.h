#pragma once

#include "text/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>

namespace pallax {

/// The moment and place that a version report names.
struct DlfTime {
    std::uint32_t seconds = 0;       ///< since 1970-01-01 UTC
    std::int16_t zoneMinutes = 0;    ///< local time minus UTC
    std::uint8_t daylightSaving = 0; ///< 1 while it is in force
};

enum class DlfResult : int { Success = 0, BufferTooSmall = 3 };

/// The size of the version report record, with which a DLF log begins.
inline constexpr std::size_t kDlfVersionReportSize = 161;

/// Writes the version report record into the first 161 bytes of `buffer`. Bytes not listed are
/// zero, numbers are little-endian, and texts are cut to fit their field and end in a NUL. On
/// failure `bytesWritten` is 0 and nothing else is written.
///
///   byte  bytes  field
///   0     2      record length, 161
///   2     2      record code, 0x1FFD
///   4     8      time stamp, 0
///   12    2      first version number
///   14    2      second version number
///   16    7      application text (at most 6 characters)
///   23    16     executable text (at most 15 characters)
///   39    24     reserved
///   63    18     build date (at most 17 characters, so that the seconds are cut off)
///   81    4      time
///   85    2      time zone, minutes, signed
///   87    2      daylight saving
///   89    72     reserved
DlfResult ETLDLFAddVersionReport(std::span<std::uint8_t> buffer, std::uint32_t& bytesWritten,
                                 std::uint16_t firstVersion, std::uint16_t secondVersion,
                                 std::string_view applicationText, std::string_view executableText,
                                 std::string_view buildDate, const DlfTime& time);

} // namespace pallax
