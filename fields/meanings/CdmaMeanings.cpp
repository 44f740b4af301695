#include "fields/Meanings.h"

#include <array>

namespace pallax {

namespace {

constexpr std::string_view kIdentity = "System Identity";
constexpr std::string_view kOneX = "1x";
constexpr std::string_view kReceiver0 = "1x / Receiver 0";
constexpr std::string_view kReceiver1 = "1x / Receiver 1";
constexpr std::string_view kEvdo = "EV-DO";
constexpr std::string_view kRates = "Data Rates";

// clang-format off
constexpr auto kMeanings = std::to_array<Meaning>({
    {kIdentity, "", "Which 1x system serves the phone."},
    {kIdentity, "System ID", "System identification (SID)."},
    {kIdentity, "Network ID", "Network identification (NID)."},
    {kIdentity, "Base Station ID", "Identity of the base station."},
    {kIdentity, "Packet Zone ID", "Packet zone; when it changes, the phone sets up packet data again."},
    {kIdentity, "Protocol Revision", "Protocol revision of the base station."},
    {kIdentity, "Roaming Indicator", "Enhanced roaming indicator."},

    {kOneX, "", "State and radio of the 1x device."},
    {kOneX, "Device State", "State of the 1x device."},
    {kOneX, "Frame Error Rate", "Share of frames in error on the forward traffic channel: a moving average in which the newest frame weighs 1/64."},
    {kOneX, "Transmit AGC", "Gain control of the transmitter: the power sent, while in Traffic."},
    {kOneX, "Active Set", "Pilots of the active set by their PN offset, each with its Ec/Io."},

    {kReceiver0, "", "The first receiver of the 1x device."},
    {kReceiver0, "Band Class", "Band class that the receiver is tuned to."},
    {kReceiver0, "Channel", "CDMA channel number that the receiver is tuned to."},
    {kReceiver0, "AGC", "Gain control of the receiver: the power received."},

    {kReceiver1, "", "The second receiver of the 1x device, shown while in Traffic."},
    {kReceiver1, "Band Class", "Band class that the receiver is tuned to."},
    {kReceiver1, "Channel", "CDMA channel number that the receiver is tuned to."},
    {kReceiver1, "AGC", "Gain control of the receiver: the power received."},

    {kEvdo, "", "State, session and radio of EV-DO."},
    {kEvdo, "Device State", "State of the EV-DO device."},
    {kEvdo, "Session State", "State of the EV-DO session."},
    {kEvdo, "UATI24", "The lower 24 bits of the unicast access terminal identifier."},
    {kEvdo, "Color Code", "Colour code of the subnet, which stands for the upper bits of the identifier."},
    {kEvdo, "Band Class", "Band class of the carrier."},
    {kEvdo, "Channel", "CDMA channel number of the carrier."},
    {kEvdo, "Serving PN Offset", "PN offset of the pilot that serves the forward link, in steps of 64 chips."},
    {kEvdo, "Receive AGC 0", "Gain control of the first receiver: the power received."},
    {kEvdo, "Receive AGC 1", "Gain control of the second receiver, from the state Access on."},
    {kEvdo, "Transmit AGC", "Gain control of the transmitter: the power sent, from the state Access on."},
    {kEvdo, "Active Set", "Pilots of the active set by their PN offset, each with its Ec/Io."},
    {kEvdo, "Finger C2I", "Carrier to interference at each finger of the receiver that is locked, by PN offset."},

    {kRates, "", "What the EV-DO links carry."},
    {kRates, "Forward Link", "Data rate of the forward link since the report before."},
    {kRates, "Reverse Link", "Data rate of the reverse link since the report before."},
});

constexpr auto kCodeNames = std::to_array<CodeName>({
    {0x108A, "Fingers of the EV-DO receiver"},
    {0x1183, "State of EV-DO"},
    {0x1192, "Counters of the EV-DO forward link"},
    {0x119C, "State of the 1x device"},
    {0x119D, "Frames of the 1x traffic channel"},
    {0x127E, "Counters of the EV-DO reverse link"},
    {0x12B6, "Active set of EV-DO"},
    {0x134F, "Identity of the 1x system"},
});
// clang-format on

} // namespace

Meanings cdmaMeanings() {
    return {kMeanings, kCodeNames};
}

} // namespace pallax
