#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The UMTS cells that the phone has found by itself, section "Detected Set". The searcher's cell
/// list empties it; cells of all set types are ignored.
///
///   0x417A, at least 16 bytes
///   byte  width  field
///   15    8      cell count; no cell is shown
class DetectedSet final : public LayoutRecord {
public:
    DetectedSet();
};

} // namespace pallax
