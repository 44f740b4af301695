#include "LogGenerator/C2K/OneXStatus.h"

#include "LogGenerator/C2K/C2KFormats.h"
#include "LogGenerator/C2K/C2KLabels.h"
#include "LogGenerator/C2K/PacketLength.h"
#include "LogGenerator/C2K/TrafficFER.h"
#include "LogGenerator/Records/Subpackets.h"
#include "platform/SystemLog.h"

#include <array>
#include <cmath>

namespace pallax {

namespace {

constexpr std::uint8_t kSystemStateId = 1;
constexpr std::uint8_t kRadioId = 2;
constexpr std::uint8_t kActiveSetId = 3;
constexpr std::uint8_t kFingersId = 4;

// Positions count from the start of their subpacket.

constexpr Position kDeviceState = u8At(4);
constexpr std::int64_t kTraffic = 8;
constexpr Condition kIsInTraffic{kDeviceState, kTraffic, kTraffic, kNotAvailable, kSystemStateId};

/// The rate of an ended call, which is shown once and then forgotten.
PropertyList oldFrameErrors(const Place& place) {
    Dictionary& state = *place.memory->state;
    const auto rate = place.here.read(kDeviceState) != kTraffic ? trafficFER(state) : std::nullopt;
    if (!rate) {
        return {};
    }
    endTrafficFER(state);
    return shownOldTrafficFER(*rate);
}

constexpr auto kDeviceStateBytes = std::to_array<Extent>({extentOf(kDeviceState)});
constexpr Computation kOldFrameErrors{
    .name = "old frame errors",
    .formula = "outside Traffic, once: the average of the call that is over",
    .read = kDeviceStateBytes,
    .compute = oldFrameErrors,
    .isRunning = true,
};

constexpr auto kSystemStateFields = std::to_array<Field>({
    {"k1xDeviceState", kDeviceState, kOneXDeviceStates, "State of the 1x device."},
    computed(kTrafficFERName, kOldTrafficFERFormat, kOldFrameErrors),
});

constexpr Conversion kReceiveGain =
    Conversion::number(kSignedLevelDbm, 334.0, -63.248).dividedBy(1000.0);
constexpr Conversion kTransmitGain = Conversion::number(kSignedLevelDbm).dividedBy(10.0);

constexpr std::string_view kBandClassMeaning = "Band class that the receiver is tuned to.";
constexpr std::string_view kChannelMeaning = "CDMA channel number that the receiver is tuned to.";
constexpr std::string_view kGainMeaning = "Gain control of the receiver: the power received.";

constexpr auto kRadioFields = std::to_array<Field>({
    {"k1xRx0BandClass", u8At(4), kBandClasses, kBandClassMeaning},
    {"k1xRx0ChanNum", u16At(6), Conversion::number(), kChannelMeaning},
    {"k1xRxAGC0", s8At(10), kReceiveGain, kGainMeaning},
    Field{"k1xRx1BandClass", u8At(5), kBandClasses, kBandClassMeaning}.when(kIsInTraffic),
    Field{"k1xRx1ChanNum", u16At(8), Conversion::number(), kChannelMeaning}.when(kIsInTraffic),
    Field{"k1xRxAGC1", s8At(11), kReceiveGain, kGainMeaning}.when(kIsInTraffic),
    Field{"k1xTxAGC", s16At(12), kTransmitGain,
          "Gain control of the transmitter: the power sent, while in Traffic."}
        .when(kIsInTraffic),
});

constexpr Position kEnergyDivisor = u16At(4);
constexpr Position kEnergyGain = u8At(6);
constexpr Position kEnergyExponent = u8At(7);
constexpr Position kPilotSize = u8At(9);
constexpr Position kReferencePN = u16At(10);
constexpr Position kPN = u16At(12); // from a pilot's start

constexpr NumberFormat kReferenceLevelDb{"(ref pilot) %+.2f dB"};

/// The position of a pilot's energy in its entry.
std::size_t energyAt(const LogRecord& activeSet) {
    return 4 * static_cast<std::size_t>(activeSet.read(kPilotSize)) + 24;
}

EntryList::Layout pilotsIn(const LogRecord& activeSet) {
    const auto size = static_cast<std::size_t>(activeSet.read(kPilotSize));
    return {.start = 0,
            .stride = (6 * size + 15) / 4 * 4,
            .bytesRead = energyAt(activeSet) + sizeof(std::uint16_t)};
}

/// A divisor of 0 gives NaN, which is shown as the least level.
PropertyList pilotLevel(const Place& place) {
    constexpr double kLeast = 0.00001;
    const LogRecord& activeSet = place.around;
    const auto divisor = static_cast<double>(activeSet.read(kEnergyDivisor));
    const auto gain = static_cast<double>(activeSet.read(kEnergyGain));
    const auto exponent = static_cast<int>(activeSet.read(kEnergyExponent));
    const double scaled = std::ldexp(place.here.u16(energyAt(activeSet)), 2 * exponent - 3);
    const double ratio = scaled / (9.0 * divisor * divisor * gain) - 1.0 / divisor;
    const bool isReference = place.here.read(kPN) == activeSet.read(kReferencePN);
    return DisplayNumber(10.0 * std::log10(std::fmax(ratio, kLeast)),
                         isReference ? kReferenceLevelDb : kSignedLevelDb);
}

constexpr auto kPilotLevelBytes = std::to_array<Extent>({
    extentOf(kEnergyDivisor),
    extentOf(kEnergyGain),
    extentOf(kEnergyExponent),
    extentOf(kPilotSize),
    extentOf(kReferencePN),
});
constexpr Computation kPilotLevel{
    .name = "scaled energy",
    .formula =
        "10 x log10 of 2^(2e - 3) x E / (9 x N^2 x g) - 1 / N, at least 0.00001: E, 16 bits, at "
        "4m + 24 of the pilot, N, 16 bits, at 4, g at 6 and e at 7 of the subpacket; for the pilot "
        "whose PN is the reference, the 16 bits at byte 10 of the subpacket, as \"(ref pilot) "
        "%+.2f dB\", for the others",
    .read = kPilotLevelBytes,
    .compute = pilotLevel,
};
constexpr auto kPilotFields = std::to_array<Field>({computed({}, kSignedLevelDb, kPilotLevel)});

constexpr auto kActiveSetLists = std::to_array<ListLayout>({{
    .key = "k1xActiveSetInfo",
    .count = u8At(8),
    .fields = kPilotFields,
    .meaning = "Pilots of the active set by their PN offset, each with its Ec/Io.",
    .entryName = kPN,
    .formula = "a pilot is 6m + 12 bytes, up to a multiple of 4, m being the byte at 9; the first "
               "one begins with the subpacket",
    .varying = pilotsIn,
}});

constexpr auto kSubpackets = std::to_array<SubpacketLayout>({
    {.id = kSystemStateId, .fields = kSystemStateFields},
    {.id = kRadioId, .fields = kRadioFields},
    {.id = kActiveSetId, .lists = kActiveSetLists},
    {.id = kFingersId},
});

bool hasItsSubpackets(const CodeLayout& code, const LogRecord& packet) {
    if (!hasLength(code, packet)) {
        return false;
    }
    const bool systemState = findSubpacket(packet, kSystemStateId).has_value();
    const bool radio = findSubpacket(packet, kRadioId).has_value();
    const bool activeSet = findSubpacket(packet, kActiveSetId).has_value();
    const bool fingers = findSubpacket(packet, kFingersId).has_value();
    const bool all = systemState && radio && activeSet && fingers;
    if (!all) {
        systemLog(LogPriority::Warning,
                  "Log code 0x119c: missing subpacket (ss=%d,rf=%d,ai=%d,fi=%d).", systemState,
                  radio, activeSet, fingers);
    }
    return all;
}

} // namespace

constexpr CodeLayout kOneXStatus{
    .logCode = 0x119C,
    .name = "State of the 1x device",
    .minimumLength = kSubpacketsStart,
    .subpackets = kSubpackets,
    .note = "Nothing is shown unless all four subpackets are there.",
    .accepts = hasItsSubpackets,
};

} // namespace pallax
