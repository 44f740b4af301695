#pragma once

#include "LogGenerator/Records/Formats.h"

#include <string_view>

/// The formats that several layouts share.
namespace pallax {

inline constexpr NumberFormat kSignedLevelDb{"%+.2f dB"};
inline constexpr NumberFormat kSignedLevelDbm{"%+.2f dBm"};

/// Shown for what the phone measures only while it transmits.
inline constexpr std::string_view kNotAvailable = "N/A";

} // namespace pallax
