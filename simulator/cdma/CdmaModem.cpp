#include "simulator/cdma/CdmaModem.h"

#include "simulator/Measurement.h"

#include <algorithm>

namespace pallax {

namespace {

using cdma::EvdoSession;
using cdma::EvdoState;
using cdma::OneXState;
using cdma::Pilot;
using Phase = Activity::Phase;

enum Layer : std::size_t { k1x, kEvdoLayer, kLayerCount };

constexpr double kNoiseDb = 0.4;
constexpr double kLeastPartDb = -15;
constexpr std::size_t kMostPilots = 4;

/// The serving pilot and other strong ones, with their shares of the received power.
struct PilotSet {
    std::array<Pilot, kMostPilots> pilots{};
    std::size_t count = 0;

    PilotSet(const RadioLayer& layer, double load, Random& random) {
        add(layer, layer.camped(), load, random);
        for (const std::size_t index : layer.neighbours()) {
            constexpr double kAddThresholdDb = -11;
            if (layer.level_dbm(index) - layer.total_dbm() > kAddThresholdDb &&
                count < kMostPilots) {
                add(layer, index, load, random);
            }
        }
    }
    std::span<const Pilot> all() const { return {pilots.data(), count}; }

private:
    void add(const RadioLayer& layer, std::size_t index, double load, Random& random) {
        constexpr double kAloneDb = -1.5;
        constexpr double kLoadDb = -3;
        const double part_db =
            layer.level_dbm(index) - layer.total_dbm() + kAloneDb + kLoadDb * load;
        pilots[count++] = {layer.cells()[index].code,
                           std::clamp(measured(part_db, kNoiseDb, random), kLeastPartDb, -0.5)};
    }
};

/// The total received power of a carrier, above that of its pilots.
double received_dbm(const RadioLayer& layer, Random& random) {
    constexpr double kAbovePilotsDb = 4;
    return measured(layer.total_dbm() + kAbovePilotsDb, kNoiseDb, random);
}

/// Open-loop power control: the weaker the cell, the higher the power.
double transmit_dbm(double receive_dbm) {
    constexpr double kSumOfBothDbm = -76;
    constexpr double kLeastDbm = -50;
    constexpr double kMostDbm = 23;
    return std::clamp(kSumOfBothDbm - receive_dbm, kLeastDbm, kMostDbm);
}

void encodeIdentity(const Scenario& scenario, ByteBuffer& out) {
    constexpr unsigned kSystem = 4139;
    constexpr unsigned kNetwork = 65;
    constexpr unsigned kRevision = 6;
    const Cell& cell = scenario.layer(k1x).campedCell();
    cdma::encode(cdma::SystemIdentity{0, kSystem, kNetwork, cell.area, kRevision, cell.identity},
                 out);
}

} // namespace

ScenarioPlan CdmaModem::plan() {
    ScenarioPlan plan;
    const LayerPlan layer = {.firstChannel = 384,
                             .codeCount = 512,
                             .firstIdentity = 2307,
                             .identityStep = 4,
                             .firstArea = 7,
                             .sitesPerSide = 6,
                             .spacing_m = 800,
                             .power_dbm = 36,
                             .least_dbm = -108};
    plan.layers.assign(kLayerCount, layer);
    plan.layers[kEvdoLayer].firstChannel = 466;
    return plan;
}

bool CdmaModem::isCall(const Scenario& scenario) const {
    return scenario.activity().isConnected() && _sessions % 2 == 1;
}

bool CdmaModem::isData(const Scenario& scenario) const {
    return scenario.activity().isConnected() && _sessions % 2 == 0;
}

void CdmaModem::observe(const Scenario& scenario, RecordQueue& queue) {
    const Activity& activity = scenario.activity();
    if (activity.hasChanged() && activity.phase() == Phase::Connected) {
        ++_sessions;
    }
    const bool registered = activity.hasChanged() && activity.phase() == Phase::Idle;
    if (scenario.layer(k1x).hasChanged() || registered) {
        encodeIdentity(scenario, queue.add());
    }
    countTraffic(scenario);
    constexpr std::chrono::milliseconds kSecond{1000};
    constexpr std::size_t kMostWaiting = 8; // at a rate too low for these counters
    if (scenario.now() % kSecond == std::chrono::milliseconds(0) && queue.size() < kMostWaiting) {
        cdma::encode(_forward, queue.add());
        cdma::encode(_reverse, queue.add());
    }
}

/// Adds the traffic of a step, and increases the sequence number each second.
void CdmaModem::countTraffic(const Scenario& scenario) {
    constexpr std::uint32_t kSteps = std::chrono::milliseconds(1000) / Scenario::kStep;
    const auto second = static_cast<std::uint32_t>(
        std::chrono::duration_cast<std::chrono::seconds>(scenario.now()).count());
    constexpr std::uint32_t kFirstSequence = 91200;
    _forward.sequence = kFirstSequence + second;
    _reverse.sequence = kFirstSequence + second;
    if (!isData(scenario)) {
        return;
    }
    const double load = scenario.activity().load();
    const auto packets = [load](double bitsPerSecond, double size) {
        return static_cast<std::uint32_t>(bitsPerSecond * load / size / kSteps);
    };
    _forward.of1024 += packets(120e3, 1024);
    _forward.of2048 += packets(400e3, 2048);
    _forward.of4096 += packets(1900e3, 4096);
    _reverse.of1024 += packets(60e3, 1024);
    _reverse.of4096 += packets(500e3, 4096);
}

void CdmaModem::report(const Scenario& scenario, Random& random, ByteBuffer& out) {
    const bool registered = scenario.activity().isRegistered();
    ReportMix<kKindCount>::Shares shares{};
    shares[kOneX] = 24;
    shares[kIdentity] = registered ? 2 : 0;
    shares[kFrame] = isCall(scenario) ? 30 : 0;
    shares[kEvdo] = 20;
    shares[kActiveSet] = registered ? 14 : 0;
    shares[kFingers] = registered ? 14 : 0;
    const RadioLayer& evdo = scenario.layer(kEvdoLayer);
    const double load = isData(scenario) ? scenario.activity().load() : 0;
    switch (_mix.next(shares)) {
    case kIdentity:
        return encodeIdentity(scenario, out);
    case kFrame: {
        // The weaker the pilot relative to the others, the more frames are lost.
        const RadioLayer& layer = scenario.layer(k1x);
        const double below_db = layer.total_dbm() - layer.campedLevel_dbm();
        return cdma::encode(cdma::TrafficFrame{random.unit() < 0.005 + 0.01 * below_db}, out);
    }
    case kEvdo:
        return reportEvdo(scenario, random, out);
    case kActiveSet:
        return cdma::encode(cdma::EvdoActiveSet{PilotSet(evdo, load, random).all()}, out);
    case kFingers:
        return cdma::encode(cdma::Fingers{PilotSet(evdo, load, random).all()}, out);
    default:
        return reportOneX(scenario, random, out);
    }
}

void CdmaModem::reportOneX(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr unsigned kPagingEvery = 5;
    constexpr double kSecondLowerDb = 1.5;
    const RadioLayer& layer = scenario.layer(k1x);
    const auto state = [&] {
        switch (scenario.activity().phase()) {
        case Phase::Off:
        case Phase::Searching:
            return OneXState::Acquisition;
        case Phase::Registering:
            return OneXState::Sync;
        default:
            break;
        }
        if (isCall(scenario)) {
            return OneXState::Traffic;
        }
        return ++_pagingTurn % kPagingEvery == 0 ? OneXState::Paging : OneXState::Sleep;
    }();
    const double level_dbm = received_dbm(layer, random);
    const PilotSet pilots(layer, isCall(scenario) ? scenario.activity().load() : 0, random);
    cdma::encode(cdma::OneXStatus{state, 0, layer.campedCell().channel, level_dbm,
                                  level_dbm - kSecondLowerDb, transmit_dbm(level_dbm),
                                  pilots.all()},
                 out);
}

void CdmaModem::reportEvdo(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr double kSecondLowerDb = 2;
    constexpr std::uint32_t kUati = 0x0A42F7;
    constexpr unsigned kColorCode = 63;
    const Phase phase = scenario.activity().phase();
    const RadioLayer& layer = scenario.layer(kEvdoLayer);
    const bool registered = scenario.activity().isRegistered();
    EvdoState state = EvdoState::Idle;
    if (phase == Phase::Off) {
        state = EvdoState::Inactive;
    } else if (phase == Phase::Searching) {
        state = EvdoState::Acquisition;
    } else if (phase == Phase::Registering || (phase == Phase::Connecting && _sessions % 2 == 1)) {
        state = EvdoState::Access;
    } else if (isData(scenario)) {
        state = EvdoState::Connected;
    }
    const EvdoSession session = registered                    ? EvdoSession::Open
                                : phase == Phase::Registering ? EvdoSession::PhoneNegotiates
                                                              : EvdoSession::Closed;
    const double level_dbm = received_dbm(layer, random);
    const bool hears = state >= EvdoState::Sync;
    cdma::encode(cdma::EvdoStatus{layer.campedCell().channel, 0, whole(level_dbm),
                                  whole(level_dbm - kSecondLowerDb), whole(transmit_dbm(level_dbm)),
                                  hears ? layer.campedCell().code : cdma::EvdoStatus::kNoPn, state,
                                  session, registered ? kUati : 0, kColorCode},
                 out);
}

} // namespace pallax
