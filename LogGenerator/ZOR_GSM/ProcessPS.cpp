#include "LogGenerator/ZOR_GSM/ProcessPS.h"

#include "LogGenerator/ZOR_GSM/MobilityStates.h"

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
    "GMM_ATTEMPING_TO_UPDATE", // sic
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
    {kMMStateKey, u8At(13), Conversion::label(kGMMStates),
     "State of the GPRS mobility management entity (GMM)."},
    {kMMSubStateKey, u8At(14), Conversion::label(kGMMSubStates),
     "Sub-state of the GPRS mobility management entity."},
    {"Attach Reject Cause", u8At(15), Conversion::label(kRejectCauses),
     "GPRS update status: how the last attach or routing area update ended."},
});

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = kGMMStateLogCode,
        .name = "State of GPRS mobility management",
        .minimumLength = kStateRecordLength,
        .fields = kStateFields,
    },
    kRegistrationCode,
});

constexpr RecordLayout kLayout{
    .section = "Process PS",
    .logLine = "ProcessPS",
    .meaning = "State of the mobility management of the packet-switched domain.",
    .codes = kCodes,
};

} // namespace

ProcessPS::ProcessPS() : LayoutRecord(kLayout) {}

} // namespace pallax
