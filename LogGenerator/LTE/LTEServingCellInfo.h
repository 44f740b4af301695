#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// Identity, frequencies and antennas of the serving cell, section "Serving Cell Info".
///
///   0xB0C2, at least 38 bytes, little-endian; removes "UARFCN", which its frequencies supersede
///   byte  width  key                   shown as
///   14    16     Physical Cell ID      number
///   16    16     Download Frequency    number; the EARFCN
///   18    16     Upload Frequency      number; the EARFCN
///   20    8      Download Bandwidth    label (kBandwidths), "Unknown" beyond; by resource blocks
///   21    8      Upload Bandwidth      label (kBandwidths), "Unknown" beyond; by resource blocks
///   22    32     Cell Identity         signed
///   26    16     Tracking Area Code    number
///   28    32     Freq Band Indicator   signed
///
///   0xB0C1, at least 22 bytes; the record is shown and then logged as unknown all the same
///   byte  width  key                   shown as
///   20    8      Num Tx Antennas       number
///
///   0xFF0001, the cell-monitor array: the first LTE serving cell
///   constant                key                  shown as
///   kHXCellMonitorTAC       Tracking Area Code   number
///   kHXCellMonitorCellId    Cell Identity        number
///   kHXCellMonitorPID       Physical Cell ID     number
///   kHXCellMonitorBandInfo  Freq Band Indicator  number
///   kHXCellMonitorUARFCN    UARFCN               number
class LTEServingCellInfo final : public LayoutRecord {
public:
    LTEServingCellInfo();
};

} // namespace pallax
