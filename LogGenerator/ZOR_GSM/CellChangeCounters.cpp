#include "LogGenerator/ZOR_GSM/CellChangeCounters.h"

namespace pallax {

namespace {

constexpr RecordLayout kLayout{
    .section = "Cell Change Counters",
    .logLine = "CellChangeCounters",
    .meaning = "Counters of cell changes; no log code is known to carry them.",
    .reportsOtherCodes = false,
};

} // namespace

CellChangeCounters::CellChangeCounters() : LayoutRecord(kLayout) {}

} // namespace pallax
