#include "LogGenerator/ZOR_GSM/MonitoredSet.h"

#include "LogGenerator/ZOR_GSM/SearcherRecord.h"

namespace pallax {

namespace {

constexpr RecordLayout kLayout{
    .section = "Monitored Set",
    .logLine = "MonitoredSet",
    .kind = SectionKind::List,
    .meaning =
        "The UMTS cells that the network tells the phone to measure; the list is always empty.",
    .codes = kEmptiedSetCodes,
};

} // namespace

MonitoredSet::MonitoredSet() : LayoutRecord(kLayout) {}

} // namespace pallax
