#include "LogGenerator/ZOR_GSM/ProcessPS.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/ZOR_GSM/MobilityStates.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr auto kGMMStates = std::to_array<std::string_view>({
    "GMM_NULL",
    "GMM_DEREGISTERED",
    "GMM_REGISTERED_INITIATED",
    "GMM_REGISTERED",
    "GMM_DEREGISTERED_INITIATED",
    "GMM_ROUTING_AREA_UPDATE_INITIATED",
    "GMM_SERVICE_REQUEST_INITIATED",
});
static_assert(kGMMStates.size() == 7);

constexpr auto kGMMSubStates = std::to_array<std::string_view>({
    "GMM_NORMAL_SERVICE",
    "GMM_LIMITED_SERVICE",
    "GMM_ATTACH_NEEDED",
    "GMM_ATTEMPTING_TO_ATTACH",
    "GMM_NO_IMSI",
    "GMM_NO_CELL_AVAILABLE",
    "GMM_PLMN_SEARCH",
    "GMM_SUSPENDED",
    "GMM_UPDATE_NEEDED",
    "GMM_ATTEMPING_TO_UPDATE", // spelled so
    "GMM_ATTEMPTING_TO_UPDATE_MM",
    "GMM_IMSI_DETACH_INITIATED",
    "GMM_NULL_SUBSTATE",
});
static_assert(kGMMSubStates.size() == 13);

constexpr auto kRejectCauses = std::to_array<std::string_view>({
    "GMM_GU1_UPDATED",
    "GMM_GU2_NOT_UPDATED",
    "GMM_GU3_PLMN_NOT_ALLOWED",
    "GMM_GU3_ROUTING_AREA_NOT_ALLOWED",
});
static_assert(kRejectCauses.size() == 4);

constexpr auto kStateFields = std::to_array<Field>({
    {kMMStateKey, u8At(13), Conversion::label(kGMMStates)},
    {kMMSubStateKey, u8At(14), Conversion::label(kGMMSubStates)},
    {"Attach Reject Cause", u8At(15), Conversion::label(kRejectCauses)},
});

constexpr auto kGroups = std::to_array<FieldGroup>({
    {kGMMStateLogCode, kStateRecordLength, kStateFields},
    kRegistrationGroup,
});
constexpr auto kLogCodes = logCodesOf(kGroups);

} // namespace

std::span<const LogCode> ProcessPS::getLogCodeArray() const {
    return kLogCodes;
}

void ProcessPS::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "ProcessPS");
    showGroup(kGroups, record, logCode);
}

bool ProcessPS::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

RecordDescription ProcessPS::describe() const {
    return describeGroups(kGroups);
}

} // namespace pallax
