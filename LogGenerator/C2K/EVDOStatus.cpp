#include "LogGenerator/C2K/EVDOStatus.h"

#include "LogGenerator/C2K/C2KFormats.h"
#include "LogGenerator/C2K/C2KLabels.h"
#include "LogGenerator/C2K/PacketLength.h"

#include <array>

namespace pallax {

namespace {

constexpr Position kDeviceState = u8At(36);
/// The first state in which the phone transmits.
constexpr std::int64_t kAccess = 4;
constexpr Condition kIsTransmitting{kDeviceState, kAccess, UINT8_MAX, kNotAvailable};

constexpr NumberFormat kSignedDbm{"%+d dBm"};
constexpr NumberFormat kChips{"%d × 64chips", "64chips"};
constexpr NumberFormat kSixHexadecimalDigits{"0x%06x"};

constexpr std::int64_t kInvalidPN = 0xFFFF;

constexpr auto kFields = std::to_array<Field>({
    {"kChannel", bitsAt(13, 0, 11), Conversion::number(), "CDMA channel number of the carrier."},
    {"k1xEVDODeviceState", kDeviceState, kEVDODeviceStates, "State of the EV-DO device."},
    {"kBandClass", bitsAt(14, 3, 5), kBandClasses, "Band class of the carrier."},
    {"kRxAGC0", s8At(15), Conversion::number(kSignedDbm),
     "Gain control of the first receiver: the power received."},
    Field{"kRxAGC1", s8At(16), Conversion::number(kSignedDbm),
          "Gain control of the second receiver, from the state Access on."}
        .when(kIsTransmitting),
    Field{"kTxAGC", s8At(17), Conversion::number(kSignedDbm),
          "Gain control of the transmitter: the power sent, from the state Access on."}
        .when(kIsTransmitting),
    {"kServingPNOffset", u16At(18), Conversion::number(kChips).except(kInvalidPN, "Invalid Value"),
     "PN offset of the pilot that serves the forward link, in steps of 64 chips."},
    {"kSessionState", u8At(37), kEVDOSessionStates, "State of the EV-DO session."},
    Field{"kUATI24", bitsAt(38, 0, 24), Conversion::number(kSixHexadecimalDigits),
          "The lower 24 bits of the unicast access terminal identifier."}
        .personal(),
    {"kColorCode", u8At(41), Conversion::number(),
     "Colour code of the subnet, which stands for the upper bits of the identifier."},
});

} // namespace

constexpr CodeLayout kEVDOStatus{
    .logCode = 0x1183,
    .name = "State of EV-DO",
    .minimumLength = 50,
    .exactLength = true,
    .fields = kFields,
    .accepts = hasLength,
};

} // namespace pallax
