#include "LogGenerator/ZOR_GSM/GSMRRInfo.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr NumberFormat kSeconds{"%d sec"};

/// Three labels carry a blank before "PROGRESS".
constexpr auto kRRStates = std::to_array<std::string_view>({
    "RR_INACTIVE",
    "RR_GOING_ACTIVE",
    "RR_GOING_INACTIVE",
    "RR_CELL_SELECTION",
    "RR_PLMN_LIST_CONSTRUCTION",
    "RR_IDLE",
    "RR_CELL_RESELECTION",
    "RR_CONNECTION_PENDING",
    "RR_CHOOSE_CELL",
    "RR_DATA_TRANSFER",
    "RR_NO_CHANNELS",
    "RR_CONNECTION_RELEASE",
    "RR_EARLY_CAMPED_WAIT_FOR_SI",
    "RR_W2G_INTERRAT_HANDOVER_ PROGRESS",
    "RR_W2G_INTERRAT_RESELECTION_PROGRESS",
    "RR_WAIT_FOR_EARLY_PSCAN",
    "GRR51",
    "GRR52",
    "RR_G2W_INTERRAT_RESELECTION_PROGRESS",
    "RR_G2W_INTERRAT_HANDOVER_ PROGRESS",
    "RR_CELL_REEST",
    "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS",
});
static_assert(kRRStates.size() == 22);

constexpr auto kStateFields = std::to_array<Field>({
    {"RR State", u8At(13), Conversion::label(kRRStates)},
    {"RR Sub State", u8At(14), Conversion::number()},
    {"RR Status", u8At(15), Conversion::number()},
    {"RR Mode", u8At(16), Conversion::flag("Data", "Voice")},
});

constexpr auto kMeasurementFields = std::to_array<Field>({
    {"Serving Rx Level", u8At(15), Conversion::number()},
    {"Rx Quality Full", s32At(16), Conversion::number()},
    {"Rx Quality Sub", s32At(20), Conversion::number()},
});

constexpr auto kDtxFields = std::to_array<Field>({
    {"DTX Used", u8At(19), Conversion::flag("ON", "OFF")},
});

constexpr auto kDrxFields = std::to_array<Field>({
    {"DRX Used", u8At(16), Conversion::number(kSeconds)},
});

constexpr auto kGroups = std::to_array<FieldGroup>({
    {0x512C, 17, kStateFields},
    {kMeasurementLogCode, kMeasurementLength, kMeasurementFields},
    {0x5072, 20, kDtxFields},
    {kPacketTimersLogCode, kPacketTimersLength, kDrxFields},
});
constexpr auto kLogCodes = logCodesOf(kGroups);

} // namespace

std::span<const LogCode> GSMRRInfo::getLogCodeArray() const {
    return kLogCodes;
}

void GSMRRInfo::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "GSMRRInfo");
    showGroup(kGroups, record, logCode);
}

bool GSMRRInfo::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

RecordDescription GSMRRInfo::describe() const {
    return describeGroups(kGroups);
}

} // namespace pallax
