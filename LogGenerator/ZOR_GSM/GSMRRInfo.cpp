#include "LogGenerator/ZOR_GSM/GSMRRInfo.h"

#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"

#include <array>

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
    {"RR State", u8At(13), Conversion::label(kRRStates), "State of the radio resource layer."},
    {"RR Sub State", u8At(14), Conversion::number(),
     "Sub-state of the radio resource layer, as a number."},
    {"RR Status", u8At(15), Conversion::number(),
     "Status of the radio resource layer, as a number."},
    {"RR Mode", u8At(16), Conversion::flag("Data", "Voice"),
     "Whether the connection is for voice or for data."},
});

constexpr auto kMeasurementFields = std::to_array<Field>({
    {"Serving Rx Level", u8At(15), Conversion::number(),
     "Receive level of the serving cell, as the modem counts it."},
    {"Rx Quality Full", s32At(16), Conversion::number(),
     "Receive quality over all frames; the record holds C1 in the same place."},
    {"Rx Quality Sub", s32At(20), Conversion::number(),
     "Receive quality over the frames that are always sent; the record holds C2 in the same "
     "place."},
});

constexpr auto kDtxFields = std::to_array<Field>({
    {"DTX Used", u8At(19), Conversion::flag("ON", "OFF"),
     "Whether discontinuous transmission is in use."},
});

constexpr auto kDrxFields = std::to_array<Field>({
    {"DRX Used", u8At(16), Conversion::number(kSeconds),
     "Discontinuous reception: how long the phone keeps listening."},
});

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = 0x512C,
        .name = "State of the GSM radio resource layer",
        .minimumLength = 17,
        .fields = kStateFields,
    },
    {
        .logCode = kMeasurementLogCode,
        .minimumLength = kMeasurementLength,
        .fields = kMeasurementFields,
    },
    {
        .logCode = 0x5072,
        .name = "Discontinuous transmission",
        .minimumLength = 20,
        .fields = kDtxFields,
    },
    {
        .logCode = kPacketTimersLogCode,
        .name = "Packet timers and discontinuous reception",
        .minimumLength = kPacketTimersLength,
        .fields = kDrxFields,
    },
});

constexpr RecordLayout kLayout{
    .section = "GSM RR Info",
    .logLine = "GSMRRInfo",
    .meaning = "State of the GSM radio resource layer, and its levels.",
    .codes = kCodes,
};

} // namespace

GSMRRInfo::GSMRRInfo() : LayoutRecord(kLayout) {}

} // namespace pallax
