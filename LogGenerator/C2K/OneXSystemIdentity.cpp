#include "LogGenerator/C2K/OneXSystemIdentity.h"

#include "LogGenerator/C2K/C2KLabels.h"
#include "LogGenerator/C2K/PacketLength.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr Position kVersion = u8At(13);
constexpr Condition kIsKnownVersion{kVersion, 2, UINT8_MAX};
/// The system type whose identity the packet carries.
constexpr Condition kIsKnownSystem{u32At(46), 2, 2, "(unknown system type %d)"};

constexpr auto kFields = std::to_array<Field>({
    {"k1xRoamingHome", u32At(42), kRoamingIndicators, "Enhanced roaming indicator."},
    Field{"kSystemId", u16At(50), Conversion::number(), "System identification (SID)."}.when(
        kIsKnownSystem),
    Field{"kNetworkId", u16At(52), Conversion::number(), "Network identification (NID)."}.when(
        kIsKnownSystem),
    {"kPacketZoneId", u8At(131), Conversion::number(),
     "Packet zone; when it changes, the phone sets up packet data again."},
    {"kBaseId", u16At(184), Conversion::number(), "Identity of the base station."},
    {"kProtocolRevision", u8At(133), Conversion::number(),
     "Protocol revision of the base station."},
});

bool isOfKnownVersion(const CodeLayout& code, const LogRecord& packet) {
    if (!hasLength(code, packet)) {
        return false;
    }
    const bool isKnown = code.condition->holdsIn(packet);
    if (!isKnown) {
        systemLog(LogPriority::Error,
                  "Log code 0x134f has version=%d; only version 2 or higher expected; dropping.",
                  packet.read(kVersion));
    }
    return isKnown;
}

} // namespace

constexpr CodeLayout kOneXSystemIdentity{
    .logCode = 0x134F,
    .name = "Identity of the 1x system",
    .minimumLength = 171,
    .condition = &kIsKnownVersion,
    .fields = kFields,
    .accepts = isOfKnownVersion,
};

} // namespace pallax
