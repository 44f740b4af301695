#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The neighbours measured in connected mode, section "Measured Neighbor Cells": a list.
///
///   0xB179, at least 29 bytes, little-endian
///   byte     width   field
///   27       8       number of entries, N
///   28       8       number of detected cells, D
///   29 + 6i  6 byte  entry i
///
///   entry
///   byte  width  key               shown as
///   0     16     Physical Cell ID  number
///   2     16     Filtered RSRP     raw x 0.25 - 140, dBm
///   4     16     Filtered RSRQ     raw x 0.125 - 20, dB
///
/// A record without entries, or whose low byte of 6 x N is above that of its length less 2 x D, is
/// refused with a line in the log, and the list stays empty. That only the low bytes are compared
/// lets some records pass that are too short, whose list then stops at the last whole entry, and
/// refuses some that are long enough.
class MeasuredNeighborCells final : public LayoutRecord {
public:
    MeasuredNeighborCells();
};

} // namespace pallax
