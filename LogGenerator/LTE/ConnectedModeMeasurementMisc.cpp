#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"

#include "LogGenerator/LTE/SharedLTERecords.h"
#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"E-ARFCN", u16At(17), Conversion::number()},
    {"Serving Physical Cell ID", u16At(19), Conversion::number()},
    {"Subframe Number", u16At(21), Conversion::number()},
    {"Serving Filtered RSRP", u16At(23), Conversion::number(kLevelDbm, 0.25, -140.0)},
    {"Serving Filtered RSRQ", u16At(25), Conversion::number(kLevelDb, 0.125, -20.0)},
});

constexpr auto kGroups =
    std::to_array<FieldGroup>({{kConnectedModeLogCode, kConnectedModeLength, kFields}});
constexpr auto kLogCodes = logCodesOf(kGroups);

} // namespace

std::span<const LogCode> ConnectedModeMeasurementMisc::getLogCodeArray() const {
    return kLogCodes;
}

void ConnectedModeMeasurementMisc::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Connected mode LTE Intra-frequency Measurement");
    showGroup(kGroups, record, logCode);
}

bool ConnectedModeMeasurementMisc::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

RecordDescription ConnectedModeMeasurementMisc::describe() const {
    return describeGroups(kGroups);
}

} // namespace pallax
