#include "LogGenerator/ZOR_GSM/VirtualActiveSet.h"

#include "LogGenerator/ZOR_GSM/SearcherRecord.h"

namespace pallax {

namespace {

constexpr RecordLayout kLayout{
    .section = "Virtual Active Set",
    .logLine = "VirtualActiveSet",
    .kind = SectionKind::List,
    .meaning = "The active set on a frequency that the phone is not on; the list is always empty.",
    .codes = kEmptiedSetCodes,
};

} // namespace

VirtualActiveSet::VirtualActiveSet() : LayoutRecord(kLayout) {}

} // namespace pallax
