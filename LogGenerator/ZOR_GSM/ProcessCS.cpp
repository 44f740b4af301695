#include "LogGenerator/ZOR_GSM/ProcessCS.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/ZOR_GSM/MobilityStates.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr auto kSubStates = std::to_array<std::string_view>({
    "MM_NULL_SUBSTATE",
    "MM_NO_IMSI",
    "MM_PLMN_SEARCH",
    "MM_LIMITED_SERVICE",
    "MM_ATTEMPTING_TO_UPDATE",
    "MM_LOCATION_UPDATE_NEEDED",
    "MM_NO_CELL_AVAILABLE",
    "MM_PLMN_SEARCH_NORMAL_SERVICE",
    "MM_NORMAL_SERVICE",
});
static_assert(kSubStates.size() == 9);

constexpr auto kRejectCauses = std::to_array<std::string_view>({
    "UPDATED",
    "NOT_UPDATED",
    "ROAMING_NOT_ALLOWED",
    "LOCATION_AREA_NOT_ALLOWED",
});
static_assert(kRejectCauses.size() == 4);

constexpr auto kStateFields = std::to_array<Field>({
    {kMMStateKey, u8At(13), Conversion::label(kMMStates)},
    {kMMSubStateKey, u8At(14), Conversion::label(kSubStates)},
    {"LU Reject Cause", u8At(15), Conversion::label(kRejectCauses)},
});

constexpr auto kGroups = std::to_array<FieldGroup>({
    {kMMStateLogCode, kStateRecordLength, kStateFields},
    kRegistrationGroup,
});
constexpr auto kLogCodes = logCodesOf(kGroups);

} // namespace

std::span<const LogCode> ProcessCS::getLogCodeArray() const {
    return kLogCodes;
}

void ProcessCS::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "ProcessCS");
    showGroup(kGroups, record, logCode);
}

bool ProcessCS::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

RecordDescription ProcessCS::describe() const {
    return describeGroups(kGroups);
}

} // namespace pallax
