#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The state of the UMTS radio link and the identity of its serving cell, section "UMTS RR Info".
///
///   0x4125, at least 14 bytes
///   byte  width  key                 shown as
///   13    8      RRC State           label (kRRCStates), "Unknown" beyond
///
///   0x4127, at least 29 bytes, little-endian; "UARFCN" is removed before "URA ID" is set
///   byte  width  key                 shown as
///   21    32     Cell ID             signed
///   17    32     Downlink Frequency  signed
///   13    32     Uplink Frequency    signed
///   25    16     URA ID              number
///
///   0x4157, at least 19 bytes
///   byte  width  key                 shown as
///   13    8      Ciphering           "Enabled", "Disabled" for 0
///
///   0x4031, at least 16 bytes, little-endian
///   byte      width    key             shown as
///   14        8                        entry count
///   16 + 14i  14 byte                  entry i, at whose byte 4 stands a signed 16-bit raw power v
///                      Transmit Power  mean, in dBm, of (v + 512) / 10 toward zero - 70 over the
///                                      entries whose v is not 0; of none, it is no number
///
///   0xFF0001, the cell-monitor array: the first UMTS serving cell
///   constant              key              shown as
///   kHXCellMonitorCellId  Cell ID          number
///   kHXCellMonitorUARFCN  UARFCN           number
///   kHXCellMonitorSCN     Scrambling Code  number
class UMTSRRInfo final : public LayoutRecord {
public:
    UMTSRRInfo();
};

} // namespace pallax
