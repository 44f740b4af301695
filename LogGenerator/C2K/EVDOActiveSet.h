#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// The pilots of the EV-DO active set and their energies.
///
///   0x12B6, at least 25 bytes and room for every pilot, little-endian
///   byte      width    lookup name        shown as
///   15        8                           number of pilots
///   25 + 12i  12 byte  kActiveSetPilots   list by pilot, or "(none)": pilot i
///
///   pilot
///   byte  width  field
///   0     16     PN offset
///   2     16     energy: 10 x log10(raw / 512), dB
extern const CodeLayout kEVDOActiveSet;

} // namespace pallax
