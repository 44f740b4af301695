#include "simulator/gsm/GsmEvents.h"

#include "simulator/common/PropertyListRecord.h"
#include "simulator/common/Subscriber.h"
#include "simulator/gsm/GsmModem.h"
#include "simulator/gsm/GsmRecords.h"
#include "simulator/gsm/NetworkRecords.h"
#include "simulator/gsm/UmtsRecords.h"

#include <array>

namespace pallax::gsm {

namespace {

using Phase = Activity::Phase;

bool onGsm(const Scenario& scenario) {
    return scenario.servingLayer() == GsmModem::kGsm;
}

/// State and sub-state of both mobility managements, and the registration, for a phase.
struct PhaseStates {
    ServiceState service;
    MobilityState circuit;
    PacketMobilityState packet;
};

PhaseStates statesOf(Phase phase) {
    switch (phase) {
    case Phase::Off:
        return {ServiceState::Inactive, {0, 0, 1}, {0, 12, 1}};
    case Phase::Searching:
        return {ServiceState::AutomaticSearch, {19, 2, 1}, {1, 6, 1}};
    case Phase::Registering: // location update, attach
        return {ServiceState::Registering, {3, 5, 1}, {2, 2, 1}};
    case Phase::Idle:
    case Phase::Releasing:
        break;
    case Phase::Updating: // both areas
        return {ServiceState::Registering, {3, 5, 0}, {5, 8, 0}};
    case Phase::Connecting: // service request
        return {ServiceState::Idle, {19, 8, 0}, {6, 0, 0}};
    case Phase::Connected:
        return {ServiceState::Idle, {19, 8, 0}, {3, 0, 0}};
    }
    return {ServiceState::Idle, {19, 8, 0}, {3, 0, 0}};
}

RrcState rrcStateOf(Phase phase) {
    switch (phase) {
    case Phase::Registering:
    case Phase::Updating:
        return RrcState::CellFach;
    case Phase::Connecting:
        return RrcState::Connecting;
    case Phase::Connected:
        return RrcState::CellDch;
    default:
        return RrcState::Disconnected;
    }
}

RrState rrStateOf(Phase phase) {
    switch (phase) {
    case Phase::Off:
    case Phase::Searching:
        return RrState::Inactive;
    case Phase::Connecting:
    case Phase::Registering:
    case Phase::Updating:
        return RrState::ConnectionPending;
    case Phase::Connected:
        return RrState::DataTransfer;
    case Phase::Releasing:
        return RrState::ConnectionRelease;
    case Phase::Idle:
        break;
    }
    return RrState::Idle;
}

void queueRadioState(const Scenario& scenario, RecordQueue& queue) {
    const Phase phase = scenario.activity().phase();
    if (onGsm(scenario)) {
        const RrState state = rrStateOf(phase);
        encode(RrInfo{state, state == RrState::DataTransfer ? 2U : 1U, 0, true}, queue.add());
    } else {
        const RrcState state = rrcStateOf(phase);
        encode(state, queue.add());
        encode(Ciphering{state == RrcState::CellDch || state == RrcState::CellFach}, queue.add());
    }
}

/// The channel of a data session on GSM, which hops between the cell's frequencies.
void queueDedicatedChannel(const Scenario& scenario, RecordQueue& queue) {
    constexpr unsigned kHoppingDistance = 8;
    const unsigned arfcn = scenario.serving().campedCell().channel;
    const std::array<unsigned, 4> hopping = {arfcn, arfcn + kHoppingDistance,
                                             arfcn + 2 * kHoppingDistance,
                                             arfcn + 3 * kHoppingDistance};
    encode(MobileAllocation{scenario.serving().campedCell().code % 64, hopping}, queue.add());
    encode(DedicatedChannel{hopping[1]}, queue.add());
    encode(Dtx{true}, queue.add());
}

/// The broadcast parameters of a GSM cell.
void queueBroadcast(const Scenario& scenario, RecordQueue& queue) {
    const Cell& cell = scenario.serving().campedCell();
    encode(ServingIdentity{cell.channel, cell.code, cell.identity & 0xFFFFU}, queue.add());
    encode(Si13Position{cell.code % 2 == 1}, queue.add());
    encode(PacketControl{1, 7, cell.code % 3}, queue.add());
    encode(PacketTimers{cell.code % 3, 2, true}, queue.add());
    encode(PacketBroadcast{false}, queue.add());
    encode(ExtendedMeasurement{1, 2, 3, 0, true}, queue.add());
}

} // namespace

void encodeServingPlmn(const Scenario& scenario, ByteBuffer& out) {
    constexpr unsigned kBothDomains = 3;
    constexpr unsigned kGsmRoutingArea = 9;
    constexpr unsigned kUmtsRoutingArea = 7;
    encode(ServingPlmn{1, kBothDomains, kHomeCountry, kHomeNetwork,
                       scenario.serving().campedCell().area,
                       onGsm(scenario) ? kGsmRoutingArea : kUmtsRoutingArea},
           out);
}

void queuePowerOn(RecordQueue& queue) {
    encodePropertyList(kPdpContextsCode, pdpContexts("mms", false), ListForm::Binary, queue.add());
}

void queuePhase(const Scenario& scenario, RecordQueue& queue) {
    const Phase phase = scenario.activity().phase();
    const PhaseStates states = statesOf(phase);
    encode(Registration{states.service, 0}, queue.add());
    encode(states.circuit, queue.add());
    encode(states.packet, queue.add());
    queueRadioState(scenario, queue);
    if (phase == Phase::Idle) {
        encodeServingPlmn(scenario, queue.add());
        encode(EquivalentPlmn{kHomeCountry, 20}, queue.add());
    }
    if (phase == Phase::Connected || phase == Phase::Releasing) {
        encodePropertyList(kPdpContextsCode, pdpContexts("mms", phase == Phase::Connected),
                           ListForm::Binary, queue.add());
    }
    const bool hasChannel = phase == Phase::Registering || phase == Phase::Updating ||
                            phase == Phase::Connecting || phase == Phase::Connected;
    if (onGsm(scenario) && hasChannel) {
        queueDedicatedChannel(scenario, queue);
    }
}

void queueServingCell(const Scenario& scenario, RecordQueue& queue) {
    const bool changesLayer = scenario.hasNewLayer() && scenario.now().count() > 0;
    if (changesLayer) {
        encode(RrInfo{onGsm(scenario) ? RrState::FromUmts : RrState::ToUmts, 0, 0, true},
               queue.add());
    }
    if (scenario.activity().isRegistered()) {
        encodeServingPlmn(scenario, queue.add()); // the cell may be in another area
    }
    if (changesLayer) {
        if (onGsm(scenario)) { // the previous technology no longer has a connection
            encode(RrcState::Disconnected, queue.add());
        } else {
            encode(RrInfo{RrState::Inactive, 0, 0, true}, queue.add());
        }
        queueRadioState(scenario, queue);
    }
    if (onGsm(scenario)) {
        queueBroadcast(scenario, queue);
        if (scenario.activity().isConnected()) {
            queueDedicatedChannel(scenario, queue);
        }
        return;
    }
    constexpr unsigned kDuplexDistance = 950;
    const Cell& cell = scenario.serving().campedCell();
    encode(UmtsIdentity{cell.channel - kDuplexDistance, cell.channel, cell.identity, cell.area},
           queue.add());
}

} // namespace pallax::gsm
