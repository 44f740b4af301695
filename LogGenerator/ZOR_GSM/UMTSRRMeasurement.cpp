#include "LogGenerator/ZOR_GSM/UMTSRRMeasurement.h"

namespace pallax {

namespace {

constexpr RecordLayout kLayout{
    .section = "UMTS RR Measurement",
    .logLine = "UMTSRRMeasurement",
    .meaning = "Measurements of the UMTS radio resource layer; no log code is known to carry them.",
    .reportsOtherCodes = false,
};

} // namespace

UMTSRRMeasurement::UMTSRRMeasurement() : LayoutRecord(kLayout) {}

} // namespace pallax
