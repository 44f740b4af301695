#include "LogGenerator/ZOR_GSM/GPRSInformation.h"

#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"

#include <array>

namespace pallax {

namespace {

/// A label from a table whose first entry is the one for 255.
constexpr Conversion labelByBytePlusOne(std::span<const std::string_view> labels) {
    return Conversion::label(labels, "Unknown", 1);
}

constexpr auto kSI13Positions = std::to_array<std::string_view>({
    "Not Available",
    "Located on BCCH",
    "Located on Extended BCCH",
});
static_assert(kSI13Positions.size() == 3);

constexpr auto kControlOrders = std::to_array<std::string_view>({
    "Not Available",
    "NC0",
    "NC1",
    "NC2",
});
static_assert(kControlOrders.size() == 4);

constexpr auto kPFCSupports = std::to_array<std::string_view>({
    "Available", // not "Not Available", unlike its siblings
    "Not Supported",
    "Supported",
});
static_assert(kPFCSupports.size() == 3);

constexpr auto kAccessThresholds = std::to_array<std::string_view>({
    "Not Available",
    "Barred (PKT access not allowed in the Cell)",
    "Barred",
    "Barred",
    "1 Only",
    "1 to 2",
    "1 to 3",
    "1 to 4",
    "Allowed",
});
static_assert(kAccessThresholds.size() == 9);

constexpr auto kT3192 = std::to_array<std::string_view>({
    "500 ms",
    "1000 ms",
    "1500 ms",
    "0 ms",
    "80 ms",
    "120 ms",
    "160 ms",
    "200 ms",
});
static_assert(kT3192.size() == 8);

constexpr auto kOperatingModes = std::to_array<std::string_view>({
    "Class 1",
    "Class 2",
    "Class 3",
});
static_assert(kOperatingModes.size() == 3);

constexpr auto kControlFields = std::to_array<Field>({
    {"Network Control Order", u8At(15), labelByBytePlusOne(kControlOrders),
     "Who decides on reselection: NC0 the phone, NC1 the phone with reports, NC2 the network."},
    {"PFC Supported", u8At(13), labelByBytePlusOne(kPFCSupports),
     "Whether the network supports packet flow contexts."},
    {"Priority Access Threshold", u8At(14), labelByBytePlusOne(kAccessThresholds),
     "Radio priorities whose packet access is allowed."},
});

constexpr auto kModeFields = std::to_array<Field>({
    {"Network Operating Mode", u8At(13), Conversion::label(kOperatingModes),
     "Network mode of operation: how paging of both domains is coordinated."},
});

constexpr auto kTimerFields = std::to_array<Field>({
    {"T3192", u8At(15), Conversion::label(kT3192, "?? ms"),
     "Timer T3192: how long the phone stays on the packet channel after the last block."},
    {"Access Burst Type", u8At(17), Conversion::flag("11-bit format", "8-bit format"),
     "Length of the access burst."},
    {"DRX Timer Max", u8At(16), Conversion::number(),
     "Largest time of non-DRX mode after packet transfer, as the cell broadcasts it."},
});

constexpr auto kPBCCHFields = std::to_array<Field>({
    {"PBCCH Present", u8At(13), Conversion::number(),
     "Whether the cell has a packet broadcast control channel, as a number."},
});

constexpr auto kPacketStatusFields = std::to_array<Field>({
    {"Ext Measurement Order", u8At(16), Conversion::number(),
     "Extended measurement order of the network, as a number."},
    {"Packet PSI Status", u8At(13), Conversion::number(),
     "Whether the network supports the packet PSI status message, as a number."},
    {"Packet SI Status", u8At(33), Conversion::flag("Supported", "Not Supported"),
     "Whether the network supports the packet SI status message."},
    {"Count LR", u8At(14), Conversion::number(), "A count of the record: it gives only the name."},
    {"Count HR", u8At(15), Conversion::number(), "A count of the record: it gives only the name."},
});

constexpr auto kSI13Fields = std::to_array<Field>({
    {"SI13 Position", u8At(14), labelByBytePlusOne(kSI13Positions),
     "On which channel system information 13 is sent."},
});

constexpr auto kHysteresisFields = std::to_array<Field>({
    {"Cell Reselect Hysteresis", u8At(26), Conversion::flag("Applied", "Not Applied"),
     "Whether the reselection hysteresis is applied."},
});

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = 0x51F5,
        .name = "Packet control parameters",
        .minimumLength = 18,
        .fields = kControlFields,
    },
    {
        .logCode = kServingPLMNLogCode,
        .minimumLength = kServingPLMNLength,
        .fields = kModeFields,
    },
    {
        .logCode = kPacketTimersLogCode,
        .minimumLength = kPacketTimersLength,
        .fields = kTimerFields,
    },
    {
        .logCode = 0x51FB,
        .name = "Packet broadcast channel",
        .minimumLength = 34,
        .fields = kPBCCHFields,
    },
    {
        .logCode = 0x51FD,
        .name = "Extended measurement and packet status",
        .minimumLength = 35,
        .fields = kPacketStatusFields,
    },
    {
        .logCode = 0x51F4,
        .name = "Position of system information 13",
        .minimumLength = 15,
        .fields = kSI13Fields,
    },
    {
        .logCode = kMeasurementLogCode,
        .minimumLength = kMeasurementLength,
        .fields = kHysteresisFields,
    },
});

constexpr RecordLayout kLayout{
    .section = "GPRS Information",
    .logLine = "GPRSInformation",
    .meaning = "Packet-data parameters that the GSM serving cell broadcasts.",
    .codes = kCodes,
};

} // namespace

GPRSInformation::GPRSInformation() : LayoutRecord(kLayout) {}

} // namespace pallax
