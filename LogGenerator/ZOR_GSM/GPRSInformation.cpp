#include "LogGenerator/ZOR_GSM/GPRSInformation.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

/// A label of a table whose first entry is what the byte 255 means.
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
    {"Network Control Order", u8At(15), labelByBytePlusOne(kControlOrders)},
    {"PFC Supported", u8At(13), labelByBytePlusOne(kPFCSupports)},
    {"Priority Access Threshold", u8At(14), labelByBytePlusOne(kAccessThresholds)},
});

constexpr auto kModeFields = std::to_array<Field>({
    {"Network Operating Mode", u8At(13), Conversion::label(kOperatingModes)},
});

constexpr auto kTimerFields = std::to_array<Field>({
    {"T3192", u8At(15), Conversion::label(kT3192, "?? ms")},
    {"Access Burst Type", u8At(17), Conversion::flag("11-bit format", "8-bit format")},
    {"DRX Timer Max", u8At(16), Conversion::number()},
});

constexpr auto kPBCCHFields = std::to_array<Field>({
    {"PBCCH Present", u8At(13), Conversion::number()},
});

constexpr auto kPacketStatusFields = std::to_array<Field>({
    {"Ext Measurement Order", u8At(16), Conversion::number()},
    {"Packet PSI Status", u8At(13), Conversion::number()},
    {"Packet SI Status", u8At(33), Conversion::flag("Supported", "Not Supported")},
    {"Count LR", u8At(14), Conversion::number()},
    {"Count HR", u8At(15), Conversion::number()},
});

constexpr auto kSI13Fields = std::to_array<Field>({
    {"SI13 Position", u8At(14), labelByBytePlusOne(kSI13Positions)},
});

constexpr auto kHysteresisFields = std::to_array<Field>({
    {"Cell Reselect Hysteresis", u8At(26), Conversion::flag("Applied", "Not Applied")},
});

/// In the order of the subscriptions.
constexpr auto kGroups = std::to_array<FieldGroup>({
    {0x51F5, 18, kControlFields},
    {kServingPLMNLogCode, kServingPLMNLength, kModeFields},
    {kPacketTimersLogCode, kPacketTimersLength, kTimerFields},
    {0x51FB, 34, kPBCCHFields},
    {0x51FD, 35, kPacketStatusFields},
    {0x51F4, 15, kSI13Fields},
    {kMeasurementLogCode, kMeasurementLength, kHysteresisFields},
});
constexpr auto kLogCodes = logCodesOf(kGroups);

} // namespace

std::span<const LogCode> GPRSInformation::getLogCodeArray() const {
    return kLogCodes;
}

void GPRSInformation::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "GPRSInformation");
    showGroup(kGroups, record, logCode);
}

bool GPRSInformation::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

RecordDescription GPRSInformation::describe() const {
    return describeGroups(kGroups);
}

} // namespace pallax
