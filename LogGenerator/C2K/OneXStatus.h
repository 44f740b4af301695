#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// The state of the 1x device, its receivers and its active set.
///
///   0x119C, at least 17 bytes, made of subpackets, all four of which must be there
///   byte  width  lookup name        shown as
///   1: system state
///   4     8      k1xDeviceState     label of the 1x device state
///                k1xTrafficFER      outside Traffic the average of the ended call, once
///   2: radio
///   4     8      k1xRx0BandClass    label of the band class
///   5     8      k1xRx1BandClass    label of the band class; "N/A" outside Traffic
///   6     16     k1xRx0ChanNum      number
///   8     16     k1xRx1ChanNum      number; "N/A" outside Traffic
///   10    8      k1xRxAGC0          signed x 334 / 1000 - 63.248, dBm
///   11    8      k1xRxAGC1          signed x 334 / 1000 - 63.248, dBm; "N/A" outside Traffic
///   12    16     k1xTxAGC           signed / 10, dBm; "N/A" outside Traffic
///   3: active set
///   4     16                        N, divides the energies
///   6     8                         g, divides them too
///   7     8                         e, their exponent
///   8     8                         number of pilots
///   9     8                         m, the size of a pilot
///   10    16                        PN offset of the reference pilot
///   0            k1xActiveSetInfo   list by pilot
///   4: fingers, not read
///
///   a pilot, 6m + 12 bytes rounded up to a multiple of 4; the first one at the subpacket's start
///   byte     width  field
///   12       16     PN offset
///   4m + 24  16     energy E: 10 x log10(max(2^(2e - 3) x E / (9 x N^2 x g) - 1 / N, 0.00001)), dB
///
/// The list ends before the first pilot that reaches past the packet. Outside Traffic the frame
/// error rate of the ended call is shown once more, as old ("k1xTrafficFER"), and then forgotten.
extern const CodeLayout kOneXStatus;

} // namespace pallax
