#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// The state of the EV-DO protocol, its carrier and its levels.
///
///   0x1183, exactly 50 bytes, little-endian
///   byte  bit  width  lookup name          shown as
///   13    0    11     kChannel             number
///   14    3    5      kBandClass           label of the band class
///   15    0    8      kRxAGC0              signed, dBm
///   16    0    8      kRxAGC1              signed, dBm; "N/A" unless the device state is 4 or more
///   17    0    8      kTxAGC               signed, dBm; "N/A" unless the device state is 4 or more
///   18    0    16     kServingPNOffset     number, 64chips, 65535 "Invalid Value"
///   36    0    8      k1xEVDODeviceState   label of the EV-DO device state
///   37    0    8      kSessionState        label of the EV-DO session state
///   38    0    24     kUATI24              number; 0x and six hexadecimal digits
///   41    0    8      kColorCode           number
extern const CodeLayout kEVDOStatus;

} // namespace pallax
