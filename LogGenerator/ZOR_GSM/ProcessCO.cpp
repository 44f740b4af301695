#include "LogGenerator/ZOR_GSM/ProcessCO.h"

#include "LogGenerator/ZOR_GSM/MobilityStates.h"

namespace pallax {

namespace {

constexpr auto kStateFields = std::to_array<Field>({
    kMMStateField,
});

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = kMMStateLogCode,
        .minimumLength = kStateRecordLength,
        .fields = kStateFields,
    },
    kRegistrationCode,
});

constexpr RecordLayout kLayout{
    .section = "Process CO",
    .logLine = "ProcessCS", // the same as ProcessCS, on purpose
    .meaning = "Registration and mobility management as Process CS shows them, without sub-state "
               "and cause.",
    .codes = kCodes,
};

} // namespace

ProcessCO::ProcessCO() : LayoutRecord(kLayout) {}

} // namespace pallax
