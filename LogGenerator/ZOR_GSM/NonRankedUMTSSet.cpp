#include "LogGenerator/ZOR_GSM/NonRankedUMTSSet.h"

namespace pallax {

namespace {

constexpr RecordLayout kLayout{
    .section = "Non-Ranked UMTS Set",
    .logLine = "NonRankedUMTSSet",
    .kind = SectionKind::List,
    .meaning = "The UMTS cells that are not ranked; no log code is known to carry them.",
    .reportsOtherCodes = false,
};

} // namespace

NonRankedUMTSSet::NonRankedUMTSSet() : LayoutRecord(kLayout) {}

} // namespace pallax
