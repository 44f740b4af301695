#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The UMTS neighbour cells, section "UMTS Set": the ranked cells or the cell monitor's cells,
/// depending on the latest record. The two have different keys and units.
///
///   0x4005, at least 15 bytes, little-endian
///   byte      width    field
///   13        8        entry count
///   15 + 10i  10 byte  entry i; the GSM entries of the record start at 15 as well
///
///   entry
///   byte  width  key                 shown as
///   2     16     Scrambling Code     number
///   4     8      RSCP                signed - 21, dB
///   7     8      Energy Per Chip     signed x 0.5, dB; six decimals
///   0     16     Downlink Frequency  signed
///   8     16     Ranking Value       signed
///   5     16     Rank Cell RSCP      signed, dB
///
///   0xFF0001, the cell-monitor array: every UMTS neighbour
///   constant              key              shown as
///   kHXCellMonitorUARFCN  UARFCN           number
///   kHXCellMonitorSCN     Scrambling Code  number
///   kHXCellMonitorRSCP    RSCP             signed, dBm, empty for 32767; of the low 16 bits
///   kHXCellMonitorECN0    Energy Per Chip  signed, dB, empty for 32767; of the low 16 bits
class UMTSSet final : public LayoutRecord {
public:
    UMTSSet();
};

} // namespace pallax
