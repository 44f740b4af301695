#include "LogGenerator/C2K/EVDOStatus.h"

#include "LogGenerator/C2K/C2KDescription.h"
#include "LogGenerator/C2K/C2KFormats.h"
#include "LogGenerator/C2K/C2KLabels.h"
#include "LogGenerator/C2K/C2KLookup.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr std::size_t kLength = 50;

constexpr Position kChannel = bitsAt(13, 0, 11);
constexpr Position kBandClass = bitsAt(14, 3, 5);
constexpr Position kRxAGC0 = s8At(15);
constexpr Position kRxAGC1 = s8At(16);
constexpr Position kTxAGC = s8At(17);
constexpr std::size_t kServingPNOffset = 18;
constexpr std::size_t kDeviceState = 36;
constexpr std::size_t kSessionState = 37;
constexpr Position kUATI24 = bitsAt(38, 0, 24);
constexpr Position kColorCode = u8At(41);

/// The first state in which the phone transmits.
constexpr std::uint8_t kAccess = 4;
constexpr std::uint16_t kInvalidPN = 0xFFFF;
constexpr std::string_view kInvalidPNText = "Invalid Value";

constexpr NumberFormat kSignedDbm{"%+d dBm"};
constexpr NumberFormat kChips{"%d × 64chips", "64chips"};
constexpr NumberFormat kSixHexadecimalDigits{"0x%06x"};

PropertyList pnOffset(std::uint16_t offset) {
    if (offset == kInvalidPN) {
        return Text::fixed(kInvalidPNText);
    }
    return DisplayNumber(std::int64_t{offset}, kChips);
}

} // namespace

void parseEVDOStatus(const LogRecord& packet, Dictionary& /*state*/, const Dictionary& lookup) {
    if (packet.length() != kLength) {
        systemLog(LogPriority::Error, "Log code 0x1183 is %u bytes long but should be %lu bytes.",
                  packet.length(), kLength);
        return;
    }
    const std::uint8_t deviceState = packet.u8(kDeviceState);
    const auto number = [&packet](const Position& position, const NumberFormat& format) {
        return DisplayNumber(packet.read(position), format);
    };
    const auto transmitting = [&](const Position& position) -> PropertyList {
        return deviceState >= kAccess ? number(position, kSignedDbm) : notAvailable();
    };
    const auto bandClass = static_cast<std::uint32_t>(packet.read(kBandClass));
    setLookupValue("kChannel", number(kChannel, kDecimal), lookup);
    setLookupValue("k1xEVDODeviceState", kEVDODeviceStates.valueOf(deviceState), lookup);
    setLookupValue("kBandClass", kBandClasses.valueOf(bandClass), lookup);
    setLookupValue("kRxAGC0", number(kRxAGC0, kSignedDbm), lookup);
    setLookupValue("kRxAGC1", transmitting(kRxAGC1), lookup);
    setLookupValue("kTxAGC", transmitting(kTxAGC), lookup);
    setLookupValue("kServingPNOffset", pnOffset(packet.u16(kServingPNOffset)), lookup);
    setLookupValue("kSessionState", kEVDOSessionStates.valueOf(packet.u8(kSessionState)), lookup);
    setLookupValue("kUATI24", number(kUATI24, kSixHexadecimalDigits), lookup);
    setLookupValue("kColorCode", number(kColorCode, kDecimal), lookup);
}

bool isWholeEVDOStatus(const LogRecord& packet) {
    return packet.length() == kLength;
}

CodeDescription describeEVDOStatus(LogCode logCode) {
    constexpr std::int64_t kLargestState = UINT8_MAX;
    const auto whileTransmitting = [](FieldDescription field) {
        field.condition = Condition{u8At(kDeviceState), kAccess, kLargestState, kNotAvailable};
        return field;
    };
    FieldDescription pnOffset = describeNumber("kServingPNOffset", u16At(kServingPNOffset), kChips);
    pnOffset.shownAs.exceptional = kInvalidPN;
    pnOffset.shownAs.exceptionalText = kInvalidPNText;

    CodeDescription code{logCode, kLength};
    code.exactLength = true;
    code.fields = {
        describeNumber("kChannel", kChannel, kDecimal),
        describeLabel("k1xEVDODeviceState", u8At(kDeviceState), kEVDODeviceStates),
        describeLabel("kBandClass", kBandClass, kBandClasses),
        describeNumber("kRxAGC0", kRxAGC0, kSignedDbm),
        whileTransmitting(describeNumber("kRxAGC1", kRxAGC1, kSignedDbm)),
        whileTransmitting(describeNumber("kTxAGC", kTxAGC, kSignedDbm)),
        std::move(pnOffset),
        describeLabel("kSessionState", u8At(kSessionState), kEVDOSessionStates),
        describeNumber("kUATI24", kUATI24, kSixHexadecimalDigits),
        describeNumber("kColorCode", kColorCode, kDecimal),
    };
    return code;
}

} // namespace pallax
