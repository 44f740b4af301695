#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The cells detected, but not measured, in connected mode, section "Detected Cells": a list.
///
///   0xB179, at least 29 bytes, little-endian
///   byte          width   field
///   27            8       number of measured neighbour entries, N
///   28            8       number of entries, D
///   29 + 6N + 2i  2 byte  entry i
///
///   entry
///   byte  width  key               shown as
///   0     16     Physical Cell ID  number
///
/// This list has no size check: a record that MeasuredNeighborCells refuses may fill it.
class DetectedCells final : public LayoutRecord {
public:
    DetectedCells();
};

} // namespace pallax
