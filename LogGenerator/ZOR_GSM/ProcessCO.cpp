#include "LogGenerator/ZOR_GSM/ProcessCO.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/ZOR_GSM/MobilityStates.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr auto kStateFields = std::to_array<Field>({
    {kMMStateKey, u8At(13), Conversion::label(kMMStates)},
});

constexpr auto kGroups = std::to_array<FieldGroup>({
    {kMMStateLogCode, kStateRecordLength, kStateFields},
    kRegistrationGroup,
});
constexpr auto kLogCodes = logCodesOf(kGroups);

} // namespace

std::span<const LogCode> ProcessCO::getLogCodeArray() const {
    return kLogCodes;
}

void ProcessCO::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "ProcessCS"); // the line of its sibling, on purpose
    showGroup(kGroups, record, logCode);
}

bool ProcessCO::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

RecordDescription ProcessCO::describe() const {
    return describeGroups(kGroups);
}

} // namespace pallax
