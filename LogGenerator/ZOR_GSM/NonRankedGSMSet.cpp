#include "LogGenerator/ZOR_GSM/NonRankedGSMSet.h"

namespace pallax {

namespace {

constexpr RecordLayout kLayout{
    .section = "Non-Ranked GSM Set",
    .logLine = "NonRankedGSMSet",
    .kind = SectionKind::List,
    .meaning = "The GSM cells that are not ranked; no log code is known to carry them.",
    .reportsOtherCodes = false,
};

} // namespace

NonRankedGSMSet::NonRankedGSMSet() : LayoutRecord(kLayout) {}

} // namespace pallax
