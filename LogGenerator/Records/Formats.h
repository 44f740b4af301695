#pragma once

#include "text/NumberFormat.h"

/// Formats shared by several records.
namespace pallax {

inline constexpr NumberFormat kDecimal{"%d"};
inline constexpr NumberFormat kUnsignedDecimal{"%u"};
inline constexpr NumberFormat kDecimalDbm{"%d dBm"};
inline constexpr NumberFormat kDecimalDb{"%d dB"};

} // namespace pallax
