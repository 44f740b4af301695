#include "LogGenerator/ZOR_GSM/ProcessCS.h"

#include "LogGenerator/ZOR_GSM/MobilityStates.h"

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
    kMMStateField,
    {kMMSubStateKey, u8At(14), Conversion::label(kSubStates),
     "Sub-state of the mobility management entity."},
    {"LU Reject Cause", u8At(15), Conversion::label(kRejectCauses),
     "Update status: how the last location update ended."},
});

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = kMMStateLogCode,
        .name = "State of mobility management",
        .minimumLength = kStateRecordLength,
        .fields = kStateFields,
    },
    kRegistrationCode,
});

constexpr RecordLayout kLayout{
    .section = "Process CS",
    .logLine = "ProcessCS",
    .meaning = "State of the mobility management of the circuit-switched domain.",
    .codes = kCodes,
};

} // namespace

ProcessCS::ProcessCS() : LayoutRecord(kLayout) {}

} // namespace pallax
