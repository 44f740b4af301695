#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// Whether a frame of the 1x traffic channel had an error; the error rate is averaged.
///
///   0x119D, at least 17 bytes, made of subpackets
///   byte  width  lookup name     shown as
///   11: traffic demodulation
///   24    8      k1xTrafficFER   an error unless 0: the average, in per cent
extern const CodeLayout kOneXTrafficErrors;

} // namespace pallax
