#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// What the fingers of the EV-DO receiver are locked to, and how well.
///
///   0x108A, exactly 23 bytes and 14 for each finger, little-endian
///   byte  width  lookup name   shown as
///   22    8                    number of fingers
///   23           kFingerC2I    list by pilot, or "(none)"
///
///   a finger, 14 bytes
///   0     16     PN offset; 0xFFFF: locked to nothing, not shown
///   6     16     carrier to interference: 10 x log10(raw / 512), dB
extern const CodeLayout kFingerC2I;

} // namespace pallax
