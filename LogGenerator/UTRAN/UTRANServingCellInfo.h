#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The identity and the frequencies of the serving cell, section "Serving Cell Info".
///
///   0xD0E2, at least 26 bytes, little-endian; keys in this order
///   byte  width  key                       shown as
///   14    8      Cell Access Restrictions  number
///   21    32     Cell ID                   signed
///   19    16     Downlink UARFCN           number
///   17    16     Uplink UARFCN             number
///   15    8      URA ID                    number
///   25    1      Allowed Access            "Emergency Calls Only", "All Calls" for 0
///
///   0xFF0001, the cell-monitor array: every serving cell of UTRAN, so that the last one stays
///   constant                key                   shown as
///   kHXCellMonitorLAC       Local Area Code       number
///   kHXCellMonitorCellId    Cell ID               number
///   kHXCellMonitorBandInfo  Freq Band Indicator   number
///   kHXCellMonitorSCN       Cell Scrambling Code  number
///   kHXCellMonitorUARFCN    Uplink UARFCN         number; the same under both keys
///   kHXCellMonitorUARFCN    Downlink UARFCN       number
///
/// Short records and other codes are ignored silently.
class UTRANServingCellInfo final : public LayoutRecord {
public:
    UTRANServingCellInfo();
};

} // namespace pallax
