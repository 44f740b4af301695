#include "LogGenerator/ZOR_GSM/GSMServingCell.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyConstants.h"

namespace pallax {

namespace {

constexpr LogCode kIdentityLogCode = 0x5134;
constexpr LogCode kDedicatedChannelLogCode = 0x5076;
constexpr auto kLogCodes = std::to_array<LogCode>(
    {kIdentityLogCode, kMeasurementLogCode, kDedicatedChannelLogCode, kCellMonitorLogCode});

constexpr std::string_view kCellIdKey = "Cell ID";
constexpr std::string_view kARFCNKey = "ARFCN";

constexpr auto kIdentityFields = std::to_array<Field>({
    {kCellIdKey, u16At(17), Conversion::number()},
    {kARFCNKey, u16At(13), Conversion::number()},
    {"BSIC", u16At(15), Conversion::number()},
});

constexpr auto kMeasurementFields = std::to_array<Field>({
    {"RSSI", u8At(15), Conversion::number(kDecimalDbm)},
    {"C1 Value", u16At(16), Conversion::number()},
    {"C2 Value", u16At(20), Conversion::number()},
});

constexpr auto kDedicatedChannelFields = std::to_array<Field>({
    {"MA Dedicated ARFCN", u8At(13), Conversion::number()},
});

constexpr auto kGroups = std::to_array<FieldGroup>({
    {kIdentityLogCode, 26, kIdentityFields},
    {kMeasurementLogCode, kMeasurementLength, kMeasurementFields},
    {kDedicatedChannelLogCode, 17, kDedicatedChannelFields},
});

constexpr auto kCellNumbers = std::to_array<CellNumber>({
    {kCellIdKey, kHXCellMonitorCellId, "GSMServingCell: Failed to retrieve Cell ID\n"},
    {kARFCNKey, kHXCellMonitorARFCN, "GSMServingCell: Failed to retrieve ARFCN\n"},
});

} // namespace

std::span<const LogCode> GSMServingCell::getLogCodeArray() const {
    return kLogCodes;
}

void GSMServingCell::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "GSMServingCell");
    if (logCode == kCellMonitorLogCode) {
        showServingCell(record);
    } else {
        showGroup(kGroups, record, logCode);
    }
}

bool GSMServingCell::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

void GSMServingCell::showServingCell(const LogRecord& record) {
    const std::optional<Array> cells = cellMonitorArrayOrLog(record);
    if (!cells) {
        return;
    }
    if (const PropertyList* cell = findCell(*cells, kHXCellMonitorRadioAccessTechnologyGSM,
                                            kHXCellMonitorCellTypeServing)) {
        showCellNumbers(sectionRef().dictionary(), kCellNumbers, *cell);
    }
}

RecordDescription GSMServingCell::describe() const {
    RecordDescription description = describeGroups(kGroups);
    description.push_back(describeCells(ListPartDescription{ListPartDescription::Kind::FirstCell,
                                                 {kHXCellMonitorRadioAccessTechnologyGSM},
                                                 kHXCellMonitorCellTypeServing},
                                        kCellNumbers, {}));
    return description;
}

} // namespace pallax
