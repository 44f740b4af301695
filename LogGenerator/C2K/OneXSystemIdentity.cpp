#include "LogGenerator/C2K/OneXSystemIdentity.h"

#include "LogGenerator/C2K/C2KDescription.h"
#include "LogGenerator/C2K/C2KFormats.h"
#include "LogGenerator/C2K/C2KLabels.h"
#include "LogGenerator/C2K/C2KLookup.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr std::size_t kMinimumLength = 171;
constexpr std::uint8_t kLeastVersion = 2;

constexpr std::size_t kVersion = 13;
constexpr std::size_t kRoamingIndicator = 42;
constexpr std::size_t kSystemType = 46;
constexpr Position kSystemId = u16At(50);
constexpr Position kNetworkId = u16At(52);
constexpr Position kPacketZoneId = u8At(131);
constexpr Position kProtocolRevision = u8At(133);
constexpr Position kBaseId = u16At(184);

/// The system type whose identity the packet carries.
constexpr std::uint32_t kKnownSystemType = 2;
constexpr std::string_view kUnknownSystemType = "(unknown system type %d)";

} // namespace

void parseOneXSystemIdentity(const LogRecord& packet, Dictionary& /*state*/,
                             const Dictionary& lookup) {
    if (!packet.has(kMinimumLength)) {
        systemLog(LogPriority::Error,
                  "Log code 0x134f is %d bytes long but must be at least %lu bytes.",
                  packet.length(), kMinimumLength);
        return;
    }
    if (const std::uint8_t version = packet.u8(kVersion); version < kLeastVersion) {
        systemLog(LogPriority::Error,
                  "Log code 0x134f has version=%d; only version 2 or higher expected; dropping.",
                  version);
        return;
    }
    const std::uint32_t systemType = packet.u32(kSystemType);
    const auto number = [&packet](const Position& position) -> PropertyList {
        return DisplayNumber(packet.read(position), kDecimal);
    };
    const auto ofKnownSystem = [&](const Position& position) -> PropertyList {
        // A text, for the number in it is not that of the row.
        return systemType == kKnownSystemType ? number(position)
                                              : formatText(kUnknownSystemType, {systemType});
    };
    setLookupValue("k1xRoamingHome", kRoamingIndicators.valueOf(packet.u32(kRoamingIndicator)),
                   lookup);
    setLookupValue("kSystemId", ofKnownSystem(kSystemId), lookup);
    setLookupValue("kNetworkId", ofKnownSystem(kNetworkId), lookup);
    setLookupValue("kPacketZoneId", number(kPacketZoneId), lookup);
    setLookupValue("kBaseId", number(kBaseId), lookup);
    setLookupValue("kProtocolRevision", number(kProtocolRevision), lookup);
}

bool isWholeOneXSystemIdentity(const LogRecord& packet) {
    return packet.has(kMinimumLength) && packet.u8(kVersion) >= kLeastVersion;
}

CodeDescription describeOneXSystemIdentity(LogCode logCode) {
    constexpr std::int64_t kLargestVersion = UINT8_MAX;
    const auto ofKnownSystem = [](FieldDescription field) {
        field.condition =
            Condition{u32At(kSystemType), kKnownSystemType, kKnownSystemType, kUnknownSystemType};
        return field;
    };
    CodeDescription code{logCode, kMinimumLength};
    code.condition = Condition{u8At(kVersion), kLeastVersion, kLargestVersion};
    code.fields = {
        describeLabel("k1xRoamingHome", u32At(kRoamingIndicator), kRoamingIndicators),
        ofKnownSystem(describeNumber("kSystemId", kSystemId, kDecimal)),
        ofKnownSystem(describeNumber("kNetworkId", kNetworkId, kDecimal)),
        describeNumber("kPacketZoneId", kPacketZoneId, kDecimal),
        describeNumber("kBaseId", kBaseId, kDecimal),
        describeNumber("kProtocolRevision", kProtocolRevision, kDecimal),
    };
    return code;
}

} // namespace pallax
