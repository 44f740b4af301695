#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The cell-change counters, section "Cell Change Counters". No log code is known to carry them:
/// the section shows, and stays empty.
class CellChangeCounters final : public LayoutRecord {
public:
    CellChangeCounters();
};

} // namespace pallax
