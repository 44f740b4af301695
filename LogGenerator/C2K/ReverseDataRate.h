#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// The amount of data on the EV-DO reverse link: counters by rate, each rate with its own weight.
/// Shown as a rate; see DataRate.h.
///
///   0x127E, at least 1750 bytes, little-endian; the sequence number stands one byte later than
///   in the packet of the forward link
///   byte      width  lookup name   shown as
///   14        32                   sequence number
///   18               kRLDataRate   three blocks of counters, 576 bytes apart: their weighted sum
///                                  since the last packet
///
///   a block: for each of the twelve rates, 24 bytes apart, two rows of four counters
///   0         4 x 32
///   288       4 x 32
extern const CodeLayout kReverseDataRate;

} // namespace pallax
