#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The neighbours measured in idle mode, section "Neighbor Cells List": a list.
///
///   0xB180, at least 21 bytes, bit-packed
///   byte      bit  width    field
///   19        6    5        number of entries less one: 1 to 32 of them
///   21 + 20i       20 byte  entry i, of which 16 bytes are read
///
///   in the entry
///   byte  bit  width  key                  shown as
///   0     0    9      Physical Cell ID     number
///   1     1    8      Measured RSSI        raw x 0.5 - 140, dBm
///   2     1    9      Measured RSRP        raw x 0.5 - 140, dBm
///   4     0    9      Average RSRP         raw x 0.5 - 140, dBm
///   5     1    7      Measured RSRQ        raw x 0.25 - 30, dB
///   6     0    7      Average RSRQ         raw x 0.25 - 30, dB
///   6     7    7      Srxlev               raw - 30, dBm
///   8     0    16     Frequency Offset     number
///   12    0    11     Ant 0 Frame Offset   number
///   13    3    19     Ant 0 Sample Offset  number
///   12    0    11     Ant 1 Frame Offset   number
///   13    3    19     Ant 1 Sample Offset  number
///
/// Antenna 1 repeats antenna 0. An RSRP step is 0.5 dB here; the serving cell's is 0.25 dB. The
/// claimed number of entries is logged, then each whole entry's cell and five levels, all five
/// with the label "Measured RSSI".
class NeighborCellsList final : public LayoutRecord {
public:
    NeighborCellsList();
};

} // namespace pallax
