#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// Identity and levels of the serving cell, section "GSM Serving Cell".
///
///   0x5134, at least 26 bytes; keys in this order
///   byte  width  key                   shown as
///   17    16     Cell ID               number
///   13    16     ARFCN                 number
///   15    16     BSIC                  number
///
///   0x5137, at least 29 bytes
///   byte  width  key                   shown as
///   15    8      RSSI                  number, dBm; the byte as it is, a positive number
///   16    16     C1 Value              number; unsigned
///   20    16     C2 Value              number; unsigned
///
///   0x5076, at least 17 bytes
///   byte  width  key                   shown as
///   13    8      MA Dedicated ARFCN    number; the low byte of a wider field
///
///   0xFF0001, the cell-monitor array: the first serving cell of GSM
///   constant                key        shown as
///   kHXCellMonitorCellId    Cell ID    number
///   kHXCellMonitorARFCN     ARFCN      number
///
/// GSMRRInfo reads the whole words at 16 and 20 of 0x5137, signed, and shows them under other
/// names.
class GSMServingCell final : public LayoutRecord {
public:
    GSMServingCell();
};

} // namespace pallax
