#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// The amount of data on the EV-DO forward link: counters, each with its own weight. Shown as a
/// rate; see DataRate.h.
///
///   0x1192, at least 241 bytes, little-endian
///   byte      width    lookup name   shown as
///   13        32                     sequence number
///   17        56 x 32  kFLDataRate   the counters: their weighted sum since the last packet
extern const CodeLayout kForwardDataRate;

} // namespace pallax
