#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The GSM cells that the phone ranks for reselection, section "GSM Set".
///
///   0x4005, at least 15 bytes, little-endian
///   byte     width   field
///   14       8       entry count
///   15 + 7i  7 byte  entry i; the UMTS entries of the record start at 15 as well
///
///   entry
///   byte  width  key            shown as
///   0     16     ARFCN          number
///   2     16     BSIC           number
///   4     8      RSSI           signed, dBm
///   5     16     Ranking Value  signed
class GSMSet final : public LayoutRecord {
public:
    GSMSet();
};

} // namespace pallax
