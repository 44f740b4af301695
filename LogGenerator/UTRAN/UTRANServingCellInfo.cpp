#include "LogGenerator/UTRAN/UTRANServingCellInfo.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyConstants.h"

#include <array>

namespace pallax {

namespace {

constexpr LogCode kServingCellLogCode = 0xD0E2;
constexpr auto kLogCodes = std::to_array<LogCode>({kServingCellLogCode, kCellMonitorLogCode});
constexpr std::size_t kServingCellLength = 26;

constexpr std::string_view kCellIdKey = "Cell ID";
constexpr std::string_view kDownlinkKey = "Downlink UARFCN";
constexpr std::string_view kUplinkKey = "Uplink UARFCN";

constexpr auto kFields = std::to_array<Field>({
    {"Cell Access Restrictions", u8At(14), Conversion::number()},
    {kCellIdKey, s32At(21), Conversion::number()},
    {kDownlinkKey, u16At(19), Conversion::number()},
    {kUplinkKey, u16At(17), Conversion::number()},
    {"URA ID", u8At(15), Conversion::number()},
    {"Allowed Access", bitsAt(25, 0, 1), Conversion::flag("Emergency Calls Only", "All Calls")},
});

constexpr auto kCellNumbers = std::to_array<CellNumber>({
    {"Local Area Code", kHXCellMonitorLAC, "Serving Cell Info: Failed to retrieve LAC\n"},
    {kCellIdKey, kHXCellMonitorCellId, "Serving Cell Info: Failed to retrieve Cell ID\n"},
    {"Freq Band Indicator", kHXCellMonitorBandInfo,
     "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
    {"Cell Scrambling Code", kHXCellMonitorSCN,
     "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"},
});

} // namespace

std::span<const LogCode> UTRANServingCellInfo::getLogCodeArray() const {
    return kLogCodes;
}

void UTRANServingCellInfo::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Serving Cell Info");
    if (logCode == kCellMonitorLogCode) {
        updateFromCellMonitor(record);
    } else if (logCode == kServingCellLogCode && record.has(kServingCellLength)) {
        show(kFields, record);
    }
}

bool UTRANServingCellInfo::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kServingCellLogCode && record.has(kServingCellLength);
}

void UTRANServingCellInfo::updateFromCellMonitor(const LogRecord& record) {
    const auto cells = readCellMonitorArray(record);
    if (!cells) {
        return;
    }
    for (const PropertyList& cell : *cells) {
        if (isCell(cell, kHXCellMonitorRadioAccessTechnologyUTRAN2,
                   kHXCellMonitorCellTypeServing)) {
            showServingCell(cell);
        }
    }
}

void UTRANServingCellInfo::showServingCell(const PropertyList& cell) {
    showCellNumbers(sectionRef().dictionary(), kCellNumbers, cell);
    const auto uarfcn =
        cellNumber(cell, kHXCellMonitorUARFCN, "Serving Cell Info: Failed to retrieve UARFCN\n");
    if (uarfcn) { // the service knows one frequency, not which link it belongs to
        show(kUplinkKey, DisplayNumber(std::int64_t{*uarfcn}, kDecimal));
        show(kDownlinkKey, DisplayNumber(std::int64_t{*uarfcn}, kDecimal));
    }
}

RecordDescription UTRANServingCellInfo::describe() const {
    CodeDescription cell{kServingCellLogCode, kServingCellLength};
    cell.fields = describeFields(kFields);
    CodeDescription monitored = describeCells(ListPartDescription{ListPartDescription::Kind::EachCell,
                                                       {kHXCellMonitorRadioAccessTechnologyUTRAN2},
                                                       kHXCellMonitorCellTypeServing},
                                              kCellNumbers, {});
    for (const std::string_view key : {kUplinkKey, kDownlinkKey}) {
        FieldDescription field{std::string(key)};
        field.shownAs.format = &kDecimal;
        field.listKey = kHXCellMonitorUARFCN;
        monitored.fields.push_back(std::move(field));
    }
    return {std::move(cell), std::move(monitored)};
}

} // namespace pallax
