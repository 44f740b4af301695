#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"

#include "LogGenerator/LTE/SharedLTERecords.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"E-ARFCN", u16At(17), Conversion::number(),
     "EARFCN of the measured frequency, which is the serving one."},
    {"Serving Physical Cell ID", u16At(19), Conversion::number(),
     "Physical cell identity of the serving cell."},
    {"Subframe Number", u16At(21), Conversion::number(),
     "Number of the subframe in which it was measured."},
    {"Serving Filtered RSRP", u16At(23), Conversion::number(kLevelDbm, 0.25, -140.0),
     "Reference signal received power of the serving cell after the layer 3 filter."},
    {"Serving Filtered RSRQ", u16At(25), Conversion::number(kLevelDb, 0.125, -20.0),
     "Reference signal received quality of the serving cell after the layer 3 filter."},
});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kConnectedModeLogCode,
    .name = "Connected-mode intra-frequency measurement",
    .minimumLength = kConnectedModeLength,
    .fields = kFields,
}});

constexpr RecordLayout kLayout{
    .section = "Connected mode LTE Intra-frequency Measurement",
    .logLine = "Connected mode LTE Intra-frequency Measurement",
    .meaning = "The serving cell in connected mode.",
    .codes = kCodes,
};

} // namespace

ConnectedModeMeasurementMisc::ConnectedModeMeasurementMisc() : LayoutRecord(kLayout) {}

} // namespace pallax
