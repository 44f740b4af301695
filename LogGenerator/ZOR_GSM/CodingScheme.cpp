#include "LogGenerator/ZOR_GSM/CodingScheme.h"

namespace pallax {

namespace {

constexpr RecordLayout kLayout{
    .section = "Coding Scheme",
    .logLine = "CellChangeCounters", // the same as the counters, on purpose
    .meaning = "GPRS coding schemes; no log code is known to carry them.",
    .reportsOtherCodes = false,
};

} // namespace

CodingScheme::CodingScheme() : LayoutRecord(kLayout) {}

} // namespace pallax
