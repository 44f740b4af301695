#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The measured neighbour cells, section "Neighboring Cells".
///
///   0x5137, at least 29 bytes
///   byte      width    field
///   28        8        number of entries
///   29 + 14i  14 byte  entry i
///
///   entry
///   byte  width  key         shown as
///   0     16     ARFCN       number
///   2     8      RSSI        number; without a unit
///   3     32     C1 Value    signed
///                BSIC        number; only for an ARFCN that the last 0x51FF told
///
///   0x51FF, at least 15 bytes; remembered for the lists to come, shows nothing itself
///   byte     width   field
///   14       8       number of entries
///   15 + 4i  4 byte  entry i
///
///   entry
///   byte  width  key         shown as
///   0     16     ARFCN       number
///   2     8      BSIC        number
///
///   0xFF0001, the cell-monitor array: every neighbour cell of GSM
///   constant               key      shown as
///   kHXCellMonitorARFCN    ARFCN    number
///   kHXCellMonitorRSSI     RSSI     signed x 2, dBm, empty for 32767; of the low 16 bits
///
/// The list comes from the latest record of 0x5137 and 0xFF0001.
class NeighboringCells final : public LayoutRecord {
public:
    NeighboringCells();
};

} // namespace pallax
