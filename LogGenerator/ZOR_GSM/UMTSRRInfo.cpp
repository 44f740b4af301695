#include "LogGenerator/ZOR_GSM/UMTSRRInfo.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyConstants.h"

#include <array>
#include <limits>

namespace pallax {

namespace {

constexpr LogCode kStateLogCode = 0x4125;
constexpr LogCode kTransmitPowerLogCode = 0x4031;
constexpr LogCode kIdentityLogCode = 0x4127;
constexpr LogCode kCipheringLogCode = 0x4157;
constexpr auto kLogCodes =
    std::to_array<LogCode>({kStateLogCode, kTransmitPowerLogCode, kIdentityLogCode,
                            kCipheringLogCode, kCellMonitorLogCode});

constexpr std::size_t kStateRecordLength = 14;
constexpr std::size_t kTransmitPowerRecordLength = 16;
constexpr std::size_t kIdentityRecordLength = 29;
constexpr std::size_t kCipheringRecordLength = 19;

constexpr auto kRRCStates = std::to_array<std::string_view>({
    "Disconnected",
    "Connecting",
    "CELL_FACH",
    "CELL_DCH",
    "CELL_PCH",
    "URA_PCH",
});
static_assert(kRRCStates.size() == 6);

constexpr auto kStateFields = std::to_array<Field>({
    {"RRC State", u8At(13), Conversion::label(kRRCStates)},
});

constexpr std::string_view kCellIdKey = "Cell ID";
constexpr std::string_view kUarfcnKey = "UARFCN";

constexpr auto kIdentityFields = std::to_array<Field>({
    {kCellIdKey, s32At(21), Conversion::number()},
    {"Downlink Frequency", s32At(17), Conversion::number()},
    {"Uplink Frequency", s32At(13), Conversion::number()},
});
constexpr auto kRegistrationAreaFields = std::to_array<Field>({
    {"URA ID", u16At(25), Conversion::number()},
});

constexpr auto kCipheringFields = std::to_array<Field>({
    {"Ciphering", u8At(13), Conversion::flag("Enabled", "Disabled")},
});

constexpr std::string_view kTransmitPowerKey = "Transmit Power";
constexpr NumberFormat kMeanDbm{"%4.2lf dBm"};
constexpr std::size_t kPowerCountOffset = 14;
constexpr EntryList::Layout kPowerEntries{16, 14, 6};
constexpr std::size_t kRawPowerOffset = 4;

/// Of a raw transmit power, in whole dBm.
int transmitPower_dbm(std::int16_t raw) {
    constexpr int kRawOffset = 512;
    constexpr int kStepsPerDb = 10;
    constexpr int kOffsetDb = 70;
    return (raw + kRawOffset) / kStepsPerDb - kOffsetDb;
}

/// Over the entries that carry a power; not a number when none does.
double meanTransmitPower_dbm(const EntryList& entries) {
    int sum_dbm = 0;
    int counted = 0;
    const std::size_t whole = entries.wholeCount();
    for (std::size_t index = 0; index < whole; ++index) {
        const std::int16_t raw = entries.at(index).s16(kRawPowerOffset);
        if (raw != 0) {
            sum_dbm += transmitPower_dbm(raw);
            ++counted;
        }
    }
    return counted != 0 ? static_cast<double>(sum_dbm) / counted
                        : std::numeric_limits<double>::quiet_NaN();
}

constexpr auto kCellNumbers = std::to_array<CellNumber>({
    {kCellIdKey, kHXCellMonitorCellId, "UMTSRRInfo: Failed to retrieve Cell ID\n"},
    {kUarfcnKey, kHXCellMonitorUARFCN, "UMTSRRInfo: Failed to retrieve UARFCN\n"},
    {"Scrambling Code", kHXCellMonitorSCN, "UMTSRRInfo: Failed to retrieve Scrambling Code\n"},
});

} // namespace

std::span<const LogCode> UMTSRRInfo::getLogCodeArray() const {
    return kLogCodes;
}

void UMTSRRInfo::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "UMTSRRInfo");
    switch (logCode) {
    case kStateLogCode:
        return updateState(record);
    case kIdentityLogCode:
        return updateIdentity(record);
    case kCipheringLogCode:
        return updateCiphering(record);
    case kTransmitPowerLogCode:
        return updateTransmitPower(record);
    case kCellMonitorLogCode:
        return updateFromCellMonitor(record);
    default:
        return logUnknown(logCode);
    }
}

void UMTSRRInfo::updateState(const LogRecord& record) {
    if (record.has(kStateRecordLength)) {
        show(kStateFields, record);
    }
}

void UMTSRRInfo::updateIdentity(const LogRecord& record) {
    if (record.has(kIdentityRecordLength)) {
        show(kIdentityFields, record);
        removeKey(kUarfcnKey); // the cell monitor's, of the cell before
        show(kRegistrationAreaFields, record);
    }
}

void UMTSRRInfo::updateCiphering(const LogRecord& record) {
    if (record.has(kCipheringRecordLength)) {
        show(kCipheringFields, record);
    }
}

void UMTSRRInfo::updateTransmitPower(const LogRecord& record) {
    if (record.has(kTransmitPowerRecordLength)) {
        const EntryList entries(record, kPowerEntries, record.u8(kPowerCountOffset));
        show(kTransmitPowerKey, DisplayNumber(meanTransmitPower_dbm(entries), kMeanDbm));
    }
}

void UMTSRRInfo::updateFromCellMonitor(const LogRecord& record) {
    const std::optional<Array> cells = cellMonitorArrayOrLog(record);
    if (!cells) {
        return;
    }
    if (const PropertyList* cell = findCell(*cells, kHXCellMonitorRadioAccessTechnologyUMTS,
                                            kHXCellMonitorCellTypeServing)) {
        showCellNumbers(sectionRef().dictionary(), kCellNumbers, *cell);
    }
}

RecordDescription UMTSRRInfo::describe() const {
    CodeDescription state{kStateLogCode, kStateRecordLength};
    state.fields = describeFields(kStateFields);

    CodeDescription power{kTransmitPowerLogCode, kTransmitPowerRecordLength};
    power.fields = {describeComputed(kTransmitPowerKey, kMeanDbm, "mean power",
                                     "the mean of (v + 512) / 10 toward zero - 70 over the entries "
                                     "whose raw power v is not 0; of none, it is no number",
                                     {{kPowerCountOffset}})};
    ListDescription entries = describeList("", kPowerEntries, u8At(kPowerCountOffset), {});
    entries.fields = {describeField({"", s16At(kRawPowerOffset), Conversion::number()})};
    entries.isShown = false;
    power.lists = {std::move(entries)};

    CodeDescription identity{kIdentityLogCode, kIdentityRecordLength};
    identity.fields = describeFields(kIdentityFields);
    for (FieldDescription& field : describeFields(kRegistrationAreaFields)) {
        identity.fields.push_back(std::move(field));
    }
    identity.note = "Removes \"UARFCN\", which is of the cell before.";

    CodeDescription ciphering{kCipheringLogCode, kCipheringRecordLength};
    ciphering.fields = describeFields(kCipheringFields);
    return {std::move(state), std::move(power), std::move(identity), std::move(ciphering),
            describeCells(ListPartDescription{ListPartDescription::Kind::FirstCell,
                                   {kHXCellMonitorRadioAccessTechnologyUMTS},
                                   kHXCellMonitorCellTypeServing},
                          kCellNumbers, {})};
}

} // namespace pallax
