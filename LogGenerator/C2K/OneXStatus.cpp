#include "LogGenerator/C2K/C2KDescription.h"
#include "LogGenerator/C2K/C2KFormats.h"
#include "LogGenerator/C2K/C2KLabels.h"
#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/C2K/OneXStatus.h"
#include "LogGenerator/C2K/PilotList.h"
#include "LogGenerator/C2K/TrafficFER.h"
#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/Records/Subpackets.h"
#include "platform/SystemLog.h"

#include <cmath>

namespace pallax {

namespace {

constexpr std::uint8_t kSystemStateId = 1;
constexpr std::uint8_t kRadioId = 2;
constexpr std::uint8_t kActiveSetId = 3;
constexpr std::uint8_t kFingersId = 4;

constexpr std::uint8_t kTraffic = 8;

constexpr NumberFormat kReferenceLevelDb{"(ref pilot) %+.2f dB"};

// From the start of their subpacket.
constexpr std::size_t kDeviceState = 4;

constexpr std::size_t kRx0BandClass = 4;
constexpr std::size_t kRx1BandClass = 5;
constexpr std::size_t kRx0Channel = 6;
constexpr std::size_t kRx1Channel = 8;
constexpr Position kRx0Gain = s8At(10);
constexpr Position kRx1Gain = s8At(11);
constexpr Position kTxGain = s16At(12);

// dBm = raw x steps / divisor + offset.
constexpr double kRxGainSteps = 334.0;
constexpr double kRxGainDivisor = 1000.0;
constexpr double kRxGainOffsetDbm = -63.248;
constexpr double kTxGainDivisor = 10.0;

constexpr std::size_t kEnergyDivisor = 4;
constexpr std::size_t kEnergyGain = 6;
constexpr std::size_t kEnergyExponent = 7;
constexpr std::size_t kPilotCount = 8;
constexpr std::size_t kPilotSize = 9;
constexpr std::size_t kReferencePN = 10;

constexpr std::size_t kPN = 12; // from a pilot's start

/// What the energies of an active set are scaled by: N, g and e of the formula.
struct EnergyScale {
    double divisor;
    double gain;
    int exponent;
};

/// A divisor of 0 leaves no number; it then shows the least level.
double pilotLevelInDb(std::uint16_t energy, const EnergyScale& scale) {
    constexpr double kLeast = 0.00001;
    const double scaled = std::ldexp(energy, 2 * scale.exponent - 3);
    const double ratio =
        scaled / (9.0 * scale.divisor * scale.divisor * scale.gain) - 1.0 / scale.divisor;
    return 10.0 * std::log10(std::fmax(ratio, kLeast));
}

/// Where the pilots lie whose size is `size`, and their energy in them.
struct PilotLayout {
    explicit PilotLayout(std::size_t size)
        : stride((6 * size + 15) / 4 * 4), energy(4 * size + 24) {}

    std::size_t stride;
    std::size_t energy;
};

/// `activeSet` starts with the subpacket and reaches to the packet's end.
PropertyList activeSetOf(const LogRecord& activeSet) {
    const EnergyScale scale = {static_cast<double>(activeSet.u16(kEnergyDivisor)),
                               static_cast<double>(activeSet.u8(kEnergyGain)),
                               activeSet.u8(kEnergyExponent)};
    const std::uint16_t referencePN = activeSet.u16(kReferencePN);
    const PilotLayout layout(activeSet.u8(kPilotSize));
    const std::size_t bytesRead = layout.energy + sizeof(std::uint16_t);
    const EntryList entries(activeSet, {0, layout.stride, bytesRead}, activeSet.u8(kPilotCount));
    const std::size_t whole = entries.wholeCount();
    PilotList pilots;
    for (std::size_t index = 0; index < whole; ++index) {
        const LogRecord pilot = entries.at(index);
        const std::uint16_t pn = pilot.u16(kPN);
        pilots.add(index, pn,
                   DisplayNumber(pilotLevelInDb(pilot.u16(layout.energy), scale),
                                 pn == referencePN ? kReferenceLevelDb : kSignedLevelDb));
    }
    return pilots.list();
}

PropertyList channel(const LogRecord& radio, std::size_t at) {
    return DisplayNumber(std::int64_t{radio.u16(at)}, kDecimal);
}

PropertyList receiveGain(const LogRecord& radio, const Position& position) {
    const auto raw = static_cast<double>(radio.read(position));
    return DisplayNumber(raw * kRxGainSteps / kRxGainDivisor + kRxGainOffsetDbm, kSignedLevelDbm);
}

PropertyList transmitGain(const LogRecord& radio) {
    return DisplayNumber(static_cast<double>(radio.read(kTxGain)) / kTxGainDivisor,
                         kSignedLevelDbm);
}

void showRadio(const LogRecord& radio, bool inTraffic, const Dictionary& lookup) {
    const auto inTrafficOnly = [inTraffic](const PropertyList& value) {
        return inTraffic ? value : notAvailable();
    };
    const auto bandClass = [&radio](std::size_t at) { return kBandClasses.valueOf(radio.u8(at)); };
    setLookupValue("k1xRx0BandClass", bandClass(kRx0BandClass), lookup);
    setLookupValue("k1xRx0ChanNum", channel(radio, kRx0Channel), lookup);
    setLookupValue("k1xRxAGC0", receiveGain(radio, kRx0Gain), lookup);
    setLookupValue("k1xRx1BandClass", inTrafficOnly(bandClass(kRx1BandClass)), lookup);
    setLookupValue("k1xRx1ChanNum", inTrafficOnly(channel(radio, kRx1Channel)), lookup);
    setLookupValue("k1xRxAGC1", inTrafficOnly(receiveGain(radio, kRx1Gain)), lookup);
    setLookupValue("k1xTxAGC", inTrafficOnly(transmitGain(radio)), lookup);
}

void showOldFrameErrors(Dictionary& state, const Dictionary& lookup) {
    if (const auto rate = trafficFER(state)) {
        setLookupValue(kTrafficFERName, shownOldTrafficFER(*rate), lookup);
        endTrafficFER(state);
    }
}

} // namespace

void parseOneXStatus(const LogRecord& packet, Dictionary& state, const Dictionary& lookup) {
    if (!packet.has(kSubpacketsStart)) {
        systemLog(LogPriority::Error,
                  "Log code 0x119c is %u bytes long but must be at least %lu bytes.",
                  packet.length(), kSubpacketsStart);
        return;
    }
    const auto systemState = findSubpacket(packet, kSystemStateId);
    const auto radio = findSubpacket(packet, kRadioId);
    const auto activeSet = findSubpacket(packet, kActiveSetId);
    const auto fingers = findSubpacket(packet, kFingersId);
    if (!systemState || !radio || !activeSet || !fingers) {
        systemLog(
            LogPriority::Warning, "Log code 0x119c: missing subpacket (ss=%d,rf=%d,ai=%d,fi=%d).",
            systemState.has_value(), radio.has_value(), activeSet.has_value(), fingers.has_value());
        return;
    }
    const std::uint8_t deviceState = systemState->u8(kDeviceState);
    setLookupValue("k1xDeviceState", kOneXDeviceStates.valueOf(deviceState), lookup);
    showRadio(*radio, deviceState == kTraffic, lookup);
    setLookupValue("k1xActiveSetInfo", activeSetOf(*activeSet), lookup);
    if (deviceState != kTraffic) {
        showOldFrameErrors(state, lookup);
    }
}

CodeDescription describeOneXStatus(LogCode logCode) {
    const auto inTraffic = [](FieldDescription field) {
        field.condition =
            Condition{u8At(kDeviceState), kTraffic, kTraffic, kNotAvailable, kSystemStateId};
        return field;
    };
    const auto receiveGain = [](std::string_view name, const Position& position) {
        return describeNumber(name, position, kSignedLevelDbm, kRxGainSteps / kRxGainDivisor,
                              kRxGainOffsetDbm);
    };
    SubpacketDescription systemState{
        kSystemStateId,
        {describeLabel("k1xDeviceState", u8At(kDeviceState), kOneXDeviceStates),
         describeOldTrafficFER(kDeviceState)}};
    SubpacketDescription radio{
        kRadioId,
        {
            describeLabel("k1xRx0BandClass", u8At(kRx0BandClass), kBandClasses),
            describeNumber("k1xRx0ChanNum", u16At(kRx0Channel), kDecimal),
            receiveGain("k1xRxAGC0", kRx0Gain),
            inTraffic(describeLabel("k1xRx1BandClass", u8At(kRx1BandClass), kBandClasses)),
            inTraffic(describeNumber("k1xRx1ChanNum", u16At(kRx1Channel), kDecimal)),
            inTraffic(receiveGain("k1xRxAGC1", kRx1Gain)),
            inTraffic(describeNumber("k1xTxAGC", kTxGain, kSignedLevelDbm, 1.0 / kTxGainDivisor)),
        }};
    ListDescription pilots;
    pilots.key = "k1xActiveSetInfo";
    pilots.count = u8At(kPilotCount);
    pilots.entryName = u16At(kPN);
    pilots.formula = "a pilot is 6m + 12 bytes, up to a multiple of 4, m being the byte at 9; the "
                     "first one begins with the subpacket";
    pilots.fields = {describeComputed(
        "", kSignedLevelDb, "scaled energy",
        "10 x log10 of 2^(2e - 3) x E / (9 x N^2 x g) - 1 / N, at least 0.00001: E, 16 bits, at "
        "4m + 24 of the pilot, N, 16 bits, at 4, g at 6 and e at 7 of the subpacket; for the pilot "
        "whose PN is the reference, the 16 bits at byte 10 of the subpacket, as \"(ref pilot) "
        "%+.2f dB\", for the others",
        {{kEnergyDivisor, sizeof(std::uint16_t)},
         {kEnergyGain},
         {kEnergyExponent},
         {kPilotSize},
         {kReferencePN, sizeof(std::uint16_t)}})};
    CodeDescription code{logCode, kSubpacketsStart};
    code.subpackets = {std::move(systemState), std::move(radio),
                       SubpacketDescription{kActiveSetId, {}, {std::move(pilots)}},
                       SubpacketDescription{kFingersId, {}}};
    code.note = "Nothing is shown unless all four subpackets are there.";
    return code;
}

} // namespace pallax
