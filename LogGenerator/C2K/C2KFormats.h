#pragma once

#include "LogGenerator/Records/Formats.h"
#include "platform/PropertyList.h"

/// The formats that several parsers share.
namespace pallax {

inline constexpr NumberFormat kSignedLevelDb{"%+.2f dB"};
inline constexpr NumberFormat kSignedLevelDbm{"%+.2f dBm"};

/// Shown for what the phone measures only while it transmits.
inline PropertyList notAvailable() {
    return Text::fixed("N/A");
}

} // namespace pallax
