#include "LogGenerator/ZOR_GSM/ProcessCO.h"

#include "LogGenerator/ZOR_GSM/MobilityStates.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr auto kLogCodes = std::to_array<LogCode>({kMMStateLogCode, kRegistrationLogCode});

constexpr auto kStateFields = std::to_array<Field>({
    {kMMStateKey, u8At(13), Conversion::label(kMMStates)},
});

} // namespace

std::span<const LogCode> ProcessCO::getLogCodeArray() const {
    return kLogCodes;
}

void ProcessCO::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "ProcessCS"); // the line of its sibling, on purpose
    if (logCode != kRegistrationLogCode && logCode != kMMStateLogCode) {
        return logUnknown(logCode);
    }
    if (!record.has(kStateRecordLength)) {
        return;
    }
    if (logCode == kRegistrationLogCode) {
        show(kRegistrationFields, record);
    } else {
        show(kStateFields, record);
    }
}

} // namespace pallax
