#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The idle-mode measurement of the serving cell and its reselection thresholds, section "Serving
/// Cell Measurements".
///
///   0xB17F, at least 33 bytes, bit-packed
///   byte  bit  width  key                                     shown as
///   13    0    8      Version                                 number
///   17    0    16     E-ARFCN                                 number
///   19    0    9      Physical Cell ID                        number
///   20    1    4      Serving Layer Priority                  number
///   21    0    9      Measured RSRP                           raw x 0.25 - 140, dBm
///   22    1    9      Average RSRP                            raw x 0.25 - 140, dBm
///   23    2    7      Measured RSRQ                           raw x 0.25 - 30, dB
///   24    1    7      Average RSRQ                            raw x 0.25 - 30, dB
///   25    0    9      Measured RSSI                           raw x 0.5 - 140, dBm
///   26    1    6      Qrxlevmin                               raw x 2 - 140, dBm
///   26    7    7      P_Max                                   raw - 30, dBm, 64 "Not Present"
///   27    6    6      Max UE Tx Power                         raw - 30, dBm, 64 "Not Present"
///   29    0    7      Srxlev                                  raw - 30, dBm
///   29    7    6      Num of Consecutive DRX Cycles of S < 0  number
///   30    5    6      S Intra Search                          raw x 2, dB, 32 "Not Present"
///   31    3    6      S Non Intra Search                      raw x 2, dBm, 32 "Not Present"
///   32    1    1      Measurement Rules Updated               "True", "False" for 0
///   32    2    4      Measurement Rules                       number
///
/// "Max UE Tx Power" is too narrow for 64, so it is always shown as a power. The two search
/// thresholds are of the same kind, but one is shown in dB and the other in dBm.
class ServingCellMeasurement final : public LayoutRecord {
public:
    ServingCellMeasurement();
};

} // namespace pallax
