#include "LogGenerator/LTE/NeighborMeasurementMisc.h"

#include "LogGenerator/LTE/SharedLTERecords.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number(), "Version of the log record's layout."},
    {"E-ARFCN", u16At(17), Conversion::number(), "EARFCN of the measured frequency."},
    {"Qrxlevmin", bitsAt(19, 0, 6), Conversion::number(kDecimalDbm, 2.0, -140.0),
     "Least RSRP that the frequency's cells demand."},
});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kNeighborMeasurementLogCode,
    .name = "Idle-mode measurement of the neighbours",
    .minimumLength = kNeighborMeasurementLength,
    .fields = kFields,
}});

constexpr RecordLayout kLayout{
    .section = "Neighbor Measurements",
    .logLine = "Neighbor Measurements",
    .meaning = "What the idle-mode measurement of the neighbours has in common.",
    .codes = kCodes,
};

} // namespace

NeighborMeasurementMisc::NeighborMeasurementMisc() : LayoutRecord(kLayout) {}

} // namespace pallax
