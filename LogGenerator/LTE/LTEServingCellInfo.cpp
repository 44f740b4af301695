#include "LogGenerator/LTE/LTEServingCellInfo.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyConstants.h"

#include <array>

namespace pallax {

namespace {

constexpr LogCode kIdentityLogCode = 0xB0C2;
constexpr LogCode kAntennasLogCode = 0xB0C1;
constexpr auto kLogCodes =
    std::to_array<LogCode>({kIdentityLogCode, kAntennasLogCode, kCellMonitorLogCode});

constexpr std::size_t kIdentityRecordLength = 38;
constexpr std::size_t kAntennasRecordLength = 22;

/// By the number of resource blocks.
constexpr auto kBandwidths = [] {
    std::array<std::string_view, 101> labels{};
    labels.fill("Unknown");
    labels[6] = "1.4 MHz";
    labels[15] = "3 MHz";
    labels[25] = "5 MHz";
    labels[50] = "10 MHz";
    labels[75] = "15 MHz";
    labels[100] = "20 MHz";
    return labels;
}();

constexpr std::string_view kPhysicalCellIdKey = "Physical Cell ID";
constexpr std::string_view kCellIdentityKey = "Cell Identity";
constexpr std::string_view kTrackingAreaKey = "Tracking Area Code";
constexpr std::string_view kBandKey = "Freq Band Indicator";
constexpr std::string_view kUarfcnKey = "UARFCN";

constexpr auto kIdentityFields = std::to_array<Field>({
    {kPhysicalCellIdKey, u16At(14), Conversion::number()},
    {"Download Frequency", u16At(16), Conversion::number()},
    {"Upload Frequency", u16At(18), Conversion::number()},
    {"Download Bandwidth", u8At(20), Conversion::label(kBandwidths)},
    {"Upload Bandwidth", u8At(21), Conversion::label(kBandwidths)},
    {kCellIdentityKey, s32At(22), Conversion::number()},
    {kTrackingAreaKey, u16At(26), Conversion::number()},
    {kBandKey, s32At(28), Conversion::number()},
});

constexpr auto kAntennasFields = std::to_array<Field>({
    {"Num Tx Antennas", u8At(20), Conversion::number()},
});

constexpr auto kCellNumbers = std::to_array<CellNumber>({
    {kTrackingAreaKey, kHXCellMonitorTAC, "Serving Cell Info: Failed to retrieve TAC\n"},
    {kCellIdentityKey, kHXCellMonitorCellId, "Serving Cell Info: Failed to retrieve Cell ID\n"},
    {kPhysicalCellIdKey, kHXCellMonitorPID,
     "Serving Cell Info: Failed to retrieve Physical Cell ID\n"},
    {kBandKey, kHXCellMonitorBandInfo,
     "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
    {kUarfcnKey, kHXCellMonitorUARFCN, "Serving Cell Info: Failed to retrieve UARFCN\n"},
});

} // namespace

std::span<const LogCode> LTEServingCellInfo::getLogCodeArray() const {
    return kLogCodes;
}

void LTEServingCellInfo::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "LTE Serving Cell Info");
    switch (logCode) {
    case kIdentityLogCode:
        return updateIdentity(record);
    case kAntennasLogCode:
        return updateAntennas(record);
    case kCellMonitorLogCode:
        return updateFromCellMonitor(record);
    default:
        return logUnknown(logCode);
    }
}

bool LTEServingCellInfo::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kIdentityLogCode && record.has(kIdentityRecordLength);
}

void LTEServingCellInfo::updateIdentity(const LogRecord& record) {
    if (record.has(kIdentityRecordLength)) {
        removeKey(kUarfcnKey); // the cell monitor's, of the cell before
        show(kIdentityFields, record);
    }
}

void LTEServingCellInfo::updateAntennas(const LogRecord& record) {
    if (record.has(kAntennasRecordLength)) {
        show(kAntennasFields, record);
        // Those who read logs expect the line behind every antenna report.
        logUnknown(kAntennasLogCode);
    }
}

void LTEServingCellInfo::updateFromCellMonitor(const LogRecord& record) {
    const auto cells = readCellMonitorArray(record);
    if (!cells) {
        return logNoCellArray();
    }
    if (const PropertyList* cell = findCell(*cells, kHXCellMonitorRadioAccessTechnologyLTE,
                                            kHXCellMonitorCellTypeServing)) {
        showCellNumbers(sectionRef().dictionary(), kCellNumbers, *cell);
    }
}

RecordDescription LTEServingCellInfo::describe() const {
    CodeDescription identity{kIdentityLogCode, kIdentityRecordLength};
    identity.fields = describeFields(kIdentityFields);
    identity.note = "Removes \"UARFCN\", which is of the cell before.";
    CodeDescription antennas{kAntennasLogCode, kAntennasRecordLength};
    antennas.fields = describeFields(kAntennasFields);
    return {std::move(identity), std::move(antennas),
            describeCells(ListPart{ListPart::Kind::FirstCell,
                                   {kHXCellMonitorRadioAccessTechnologyLTE},
                                   kHXCellMonitorCellTypeServing},
                          kCellNumbers, {})};
}

} // namespace pallax
