#include "simulator/utran/UtranModem.h"

#include "simulator/Measurement.h"
#include "simulator/common/CellMonitor.h"
#include "simulator/common/PropertyListRecord.h"
#include "simulator/common/Subscriber.h"

#include <algorithm>

namespace pallax {

namespace {

using utran::RrcMode;
using Phase = Activity::Phase;

enum Layer : std::size_t { kUtran, kGsm, kLayerCount };

constexpr unsigned kFirstArea = 0x1A2B;
constexpr unsigned kFirstUra = 3;
constexpr unsigned kBand = 34;
constexpr double kNoiseDb = 0.6;

/// From the weakest audible level, in the 256 steps of the log record.
unsigned filteredRscp(double level_dbm) {
    constexpr double kLeastDbm = -116;
    constexpr double kStepDb = 0.3;
    return rawOf(level_dbm, kLeastDbm, kStepDb, 8);
}

void encodeServing(const Scenario& scenario, ByteBuffer& out) {
    const Cell& cell = scenario.layer(kUtran).campedCell();
    // Both links share the carrier.
    utran::encode(utran::ServingCell{0, cell.area - kFirstArea + kFirstUra, cell.channel,
                                     cell.channel, cell.identity,
                                     !scenario.activity().isRegistered()},
                  out);
}

void reportNeighbours(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr std::size_t kMonitored = 5; // the strongest; others are only detected
    const RadioLayer& layer = scenario.layer(kUtran);
    std::array<utran::MeasuredCell, RadioLayer::kMostHeard + 1> cells{};
    std::size_t count = 0;
    const auto add = [&](std::size_t index, utran::Set set) {
        const Cell& cell = layer.cells()[index];
        const double level_dbm = measured(layer.level_dbm(index), kNoiseDb, random);
        cells[count++] = {cell.channel, cell.code, filteredRscp(level_dbm), set,
                          set == utran::Set::Active};
    };
    add(layer.camped(), utran::Set::Active);
    for (const std::size_t index : layer.neighbours()) {
        add(index, count <= kMonitored ? utran::Set::Monitored : utran::Set::Detected);
    }
    utran::encode(std::span<const utran::MeasuredCell>(cells.data(), count), out);
}

void reportGsmNeighbours(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr unsigned kBccBits = 3;
    constexpr unsigned kBccMask = 7;
    const RadioLayer& layer = scenario.layer(kGsm);
    std::array<utran::GsmNeighbour, RadioLayer::kMostHeard> cells{};
    unsigned count = 0;
    for (const std::size_t index : layer.neighbours()) {
        const Cell& cell = layer.cells()[index];
        cells[count] = {count,
                        0,
                        true,
                        cell.code >> kBccBits,
                        cell.code & kBccMask,
                        cell.channel,
                        whole(measured(layer.level_dbm(index), kNoiseDb, random))};
        ++count;
    }
    utran::encode(std::span<const utran::GsmNeighbour>(cells.data(), count), out);
}

/// The weaker the cell relative to the others, the worse the channels.
void reportQuality(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr double kBestRatio = 42;
    constexpr double kMostErrors = 60;
    const RadioLayer& layer = scenario.layer(kUtran);
    const double below_db = layer.total_dbm() - layer.campedLevel_dbm();
    const double errors = 1 + 5 * below_db + 2 * scenario.activity().load();
    std::array<utran::TransportChannel, 3> transport{};
    std::array<utran::CompositeChannel, 2> composite{};
    unsigned id = 1;
    for (utran::TransportChannel& channel : transport) {
        channel = {id++, static_cast<unsigned>(
                             std::clamp(measured(errors, 1.0, random), 0.0, kMostErrors))};
    }
    id = 1;
    for (utran::CompositeChannel& channel : composite) {
        constexpr unsigned kFirstSlot = 3;
        channel.id = id;
        channel.timeSlot = kFirstSlot + id++;
        for (unsigned& ratio : channel.ratios) {
            ratio = static_cast<unsigned>(
                std::clamp(kBestRatio - 4 * below_db + random.normal(), 0.0, 63.0));
        }
    }
    utran::encode(utran::ChannelQuality{transport, composite}, out);
}

} // namespace

ScenarioPlan UtranModem::plan() {
    ScenarioPlan plan;
    plan.layers.resize(kLayerCount);
    plan.layers[kUtran] = {.firstChannel = 10088,
                           .channelStep = 8,
                           .channelCount = 3,
                           .codeCount = 128,
                           .firstIdentity = 0x00A40C01,
                           .identityStep = 0x2101,
                           .firstArea = kFirstArea,
                           .sitesPerSide = 6,
                           .spacing_m = 700,
                           .power_dbm = 30,
                           .least_dbm = -105};
    plan.layers[kGsm] = {.firstChannel = 17,
                         .channelStep = 7,
                         .channelCount = 16,
                         .codeCount = 64,
                         .sitesPerSide = 4,
                         .spacing_m = 1100,
                         .power_dbm = 40,
                         .least_dbm = -104,
                         .updateEvery = 3};
    return plan;
}

/// After each session the phone waits in a different one of the states that save its battery.
void UtranModem::choosePhaseMode(Phase phase) {
    constexpr std::array<RrcMode, 3> kWaiting = {RrcMode::Disconnected, RrcMode::Pch,
                                                 RrcMode::UraPch};
    switch (phase) {
    case Phase::Connecting:
        _mode = RrcMode::Connecting;
        break;
    case Phase::Connected:
        _mode = RrcMode::Dch;
        ++_sessions;
        break;
    case Phase::Registering:
    case Phase::Updating:
    case Phase::Releasing:
        _mode = RrcMode::Fach;
        break;
    case Phase::Idle:
        _mode = kWaiting[_sessions % kWaiting.size()];
        break;
    case Phase::Off:
    case Phase::Searching:
        _mode = RrcMode::Disconnected;
        break;
    }
}

void UtranModem::observe(const Scenario& scenario, RecordQueue& queue) {
    const Phase phase = scenario.activity().phase();
    const unsigned area = scenario.layer(kUtran).campedCell().area;
    if (_simReading.isDue(scenario)) {
        encodePropertyList(kSimFilesCode, simFiles("UTRAN preferred", area), ListForm::Binary,
                           queue.add());
    }
    if (scenario.now().count() == 0) {
        encodePropertyList(kPdpContextsCode, pdpContexts("mms", false), ListForm::Xml, queue.add());
    }
    if (scenario.hasNewServingCell() ||
        (scenario.activity().hasChanged() && phase == Phase::Idle)) {
        encodeServing(scenario, queue.add());
    }
    if (!scenario.activity().hasChanged()) {
        return;
    }
    choosePhaseMode(phase);
    utran::encode(_mode, queue.add());
    if (phase == Phase::Connected || phase == Phase::Releasing) {
        encodePropertyList(kPdpContextsCode, pdpContexts("mms", phase == Phase::Connected),
                           ListForm::Binary, queue.add());
    }
}

void UtranModem::report(const Scenario& scenario, Random& random, ByteBuffer& out) {
    ReportMix<kKindCount>::Shares shares{};
    shares[kMode] = 4;
    shares[kServing] = 4;
    shares[kMonitor] = 1;
    shares[kNeighbours] = 80;
    shares[kGsmNeighbours] = 28;
    shares[kQuality] = scenario.activity().isConnected() ? 40 : 0;
    switch (_mix.next(shares)) {
    case kMode:
        return utran::encode(_mode, out);
    case kServing:
        return encodeServing(scenario, out);
    case kNeighbours:
        return reportNeighbours(scenario, random, out);
    case kGsmNeighbours:
        return reportGsmNeighbours(scenario, random, out);
    case kQuality:
        return reportQuality(scenario, random, out);
    default:
        return reportCellMonitor(scenario, out);
    }
}

void UtranModem::reportCellMonitor(const Scenario& scenario, ByteBuffer& out) {
    constexpr unsigned kFormTurn = 4;
    const std::string_view technology = kHXCellMonitorRadioAccessTechnologyUTRAN2;
    const RadioLayer& layer = scenario.layer(kUtran);
    const Cell& serving = layer.campedCell();
    Array cells = {cellMonitorEntry(technology, CellRole::Serving,
                                    {{kHXCellMonitorLAC, serving.area},
                                     {kHXCellMonitorCellId, serving.identity},
                                     {kHXCellMonitorBandInfo, kBand},
                                     {kHXCellMonitorSCN, serving.code},
                                     {kHXCellMonitorUARFCN, serving.channel}})};
    for (const std::size_t index : layer.neighbours()) {
        const Cell& cell = layer.cells()[index];
        cells.push_back(cellMonitorEntry(
            technology, CellRole::Neighbour,
            {{kHXCellMonitorSCN, cell.code}, {kHXCellMonitorUARFCN, cell.channel}}));
    }
    const RadioLayer& gsm = scenario.layer(kGsm);
    for (const std::size_t index : gsm.neighbours()) {
        cells.push_back(gsmNeighbourEntry(gsm.cells()[index], gsm.level_dbm(index)));
    }
    const ListForm form = ++_monitorTurn % kFormTurn == 0 ? ListForm::Xml : ListForm::Binary;
    encodePropertyList(kCellMonitorCode, cells, form, out);
}

} // namespace pallax
