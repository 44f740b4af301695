#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The cell-change counters, section "Cell Change Counters". No log code is known to carry them,
/// so the section stays empty.
class CellChangeCounters final : public LayoutRecord {
public:
    CellChangeCounters();
};

} // namespace pallax
