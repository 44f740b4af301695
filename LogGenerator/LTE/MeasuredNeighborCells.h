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
/// A record is refused if N is 0, or if the low byte of 6 x N is above the low byte of its length
/// less 2 x D: the list is emptied and a line is logged. Because only the low bytes are compared,
/// some records that are too short pass (their list ends at the last whole entry), and some that
/// are long enough are refused.
class MeasuredNeighborCells final : public LayoutRecord {
public:
    MeasuredNeighborCells();
};

} // namespace pallax
