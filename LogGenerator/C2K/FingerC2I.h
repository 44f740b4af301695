#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// The pilots to which the fingers of the EV-DO receiver are locked, and their levels.
///
///   0x108A, at least 23 bytes, and exactly 14 more for each finger, little-endian
///   byte      width    lookup name   shown as
///   22        8                      number of fingers
///   23 + 14i  14 byte  kFingerC2I    list by pilot, or "(none)": finger i
///
///   finger
///   byte  width  field
///   0     16     PN offset; 0xFFFF: locked to nothing, not shown
///   6     16     carrier to interference: 10 x log10(raw / 512), dB
extern const CodeLayout kFingerC2I;

} // namespace pallax
