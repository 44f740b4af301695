#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The idle-mode measurement of neighbours, section "Neighbor Measurements": the fixed part of the
/// record whose list NeighborCellsList shows.
///
///   0xB180, at least 21 bytes, bit-packed
///   byte  bit  width  key        shown as
///   13    0    8      Version    number
///   17    0    16     E-ARFCN    number
///   19    0    6      Qrxlevmin  raw x 2 - 140, dBm
class NeighborMeasurementMisc final : public LayoutRecord {
public:
    NeighborMeasurementMisc();
};

} // namespace pallax
