#pragma once

#include "LogGenerator/Records/Formats.h"

#include <string_view>

/// Formats shared by several layouts.
namespace pallax {

inline constexpr NumberFormat kSignedLevelDb{"%+.2f dB"};
inline constexpr NumberFormat kSignedLevelDbm{"%+.2f dBm"};

/// Shown for values that the phone measures only while it transmits.
inline constexpr std::string_view kNotAvailable = "N/A";

} // namespace pallax
