#include "LogGenerator/ZOR_GSM/DetectedSet.h"

#include "LogGenerator/ZOR_GSM/SearcherRecord.h"

namespace pallax {

namespace {

constexpr RecordLayout kLayout{
    .section = "Detected Set",
    .logLine = "DetectedSet",
    .kind = SectionKind::List,
    .meaning = "The UMTS cells that the phone has found by itself; the list is always empty.",
    .codes = kEmptiedSetCodes,
};

} // namespace

DetectedSet::DetectedSet() : LayoutRecord(kLayout) {}

} // namespace pallax
