#include "simulator/ifx/IfxModem.h"

#include "simulator/Measurement.h"
#include "simulator/ifx/Picture.h"

#include <algorithm>
#include <array>
#include <optional>

namespace pallax {

namespace {

using Phase = Activity::Phase;

constexpr double kRxLevelNoiseDb = 0.6;
constexpr int kLeastAccessDbm = -105;

ifx::ColourCode bsicOf(const Cell& cell) {
    constexpr unsigned kColours = 8;
    return {cell.code / kColours % kColours, cell.code % kColours};
}

ifx::RrState stateOf(const Activity& activity) {
    switch (activity.phase()) {
    case Phase::Off:
        return ifx::RrState::Off;
    case Phase::Searching:
        return ifx::RrState::Selection;
    case Phase::Registering:
    case Phase::Updating:
    case Phase::Connecting:
        return ifx::RrState::Establishment;
    case Phase::Connected:
        return ifx::RrState::Dedicated;
    case Phase::Releasing:
        return ifx::RrState::Release;
    case Phase::Idle:
        break;
    }
    return ifx::RrState::Idle;
}

ifx::ServingCell servingCell(const Scenario& scenario, Random& random) {
    const RadioLayer& layer = scenario.serving();
    const Cell& cell = layer.campedCell();
    const int level_dbm = whole(measured(layer.campedLevel_dbm(), kRxLevelNoiseDb, random));
    return {cell.channel, bsicOf(cell), level_dbm, level_dbm - kLeastAccessDbm,
            cell.area,    cell.identity};
}

using Neighbours = std::array<ifx::NeighbourCell, ifx::Picture::kMostNeighbours>;

/// The BSIC of a weak cell cannot be read.
std::size_t neighbourCells(const Scenario& scenario, Random& random, Neighbours& cells) {
    constexpr int kReadableDbm = -98;
    const RadioLayer& layer = scenario.serving();
    const auto heard = layer.neighbours();
    std::size_t count = 0;
    for (const std::size_t index : heard.first(std::min(heard.size(), cells.size()))) {
        const Cell& cell = layer.cells()[index];
        const int level_dbm = whole(measured(layer.level_dbm(index), kRxLevelNoiseDb, random));
        cells[count++] = {cell.channel, level_dbm >= kReadableDbm, bsicOf(cell), level_dbm};
    }
    return count;
}

using Hopping = std::array<unsigned, 4>;

/// Nothing while idle.
std::optional<ifx::DedicatedChannel> dedicatedChannel(const Scenario& scenario, Random& random,
                                                      Hopping& hopping) {
    const Activity& activity = scenario.activity();
    if (!activity.isConnected() && activity.phase() != Phase::Connecting) {
        return std::nullopt;
    }
    constexpr double kPathToPowerDb = -58;
    constexpr double kLeastPowerDbm = 5;
    constexpr double kMostPowerDbm = 33;
    constexpr double kNearDbm = -75;
    constexpr int kWorstQuality = 7;
    const RadioLayer& layer = scenario.serving();
    const double below_db = layer.total_dbm() - layer.campedLevel_dbm();
    const double power_dbm =
        std::clamp(kPathToPowerDb - layer.campedLevel_dbm(), kLeastPowerDbm, kMostPowerDbm);
    const int quality = std::clamp(whole(below_db + random.normal() / 2), 0, kWorstQuality);
    ifx::DedicatedChannel channel{ifx::ChannelType::Signalling,
                                  1,
                                  layer.campedLevel_dbm() > kNearDbm ? 1U : 2U,
                                  static_cast<unsigned>(quality),
                                  whole(power_dbm),
                                  {}};
    if (activity.isConnected()) {
        constexpr unsigned kTrafficSlot = 3;
        constexpr unsigned kHoppingDistance = 9;
        unsigned arfcn = layer.campedCell().channel;
        for (unsigned& each : hopping) {
            each = arfcn;
            arfcn += kHoppingDistance;
        }
        channel.type = ifx::ChannelType::Traffic;
        channel.timeSlot = kTrafficSlot;
        channel.hopping = hopping;
    }
    return channel;
}

} // namespace

ScenarioPlan IfxModem::plan() {
    ScenarioPlan plan;
    plan.layers = {{.firstChannel = 11,
                    .channelStep = 3, // so that hopping stays in the band
                    .channelCount = 25,
                    .codeCount = 64,
                    .firstIdentity = 20817,
                    .identityStep = 11,
                    .firstArea = 6699,
                    .sitesPerSide = 5,
                    .spacing_m = 900,
                    .power_dbm = 42,
                    .least_dbm = -103}};
    return plan;
}

/// Does nothing: every message contains everything.
void IfxModem::observe(const Scenario& /*scenario*/, RecordQueue& /*queue*/) {}

void IfxModem::report(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr unsigned kFormTurn = 8;
    Neighbours neighbours; // only those that can be heard are written
    Hopping hopping{};
    ifx::Picture picture{};
    picture.isRegistered = scenario.activity().isRegistered();
    picture.state = stateOf(scenario.activity());
    picture.serving = servingCell(scenario, random);
    const std::size_t heard = neighbourCells(scenario, random, neighbours);
    picture.neighbours = std::span(neighbours).first(heard);
    picture.dedicated = dedicatedChannel(scenario, random, hopping);
    ifx::encode(picture, ++_turn % kFormTurn == 0 ? ListForm::Xml : ListForm::Binary, out);
}

} // namespace pallax
