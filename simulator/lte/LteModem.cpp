#include "simulator/lte/LteModem.h"

#include "simulator/Measurement.h"
#include "simulator/common/CellMonitor.h"
#include "simulator/common/PropertyListRecord.h"
#include "simulator/common/Subscriber.h"
#include "simulator/lte/LteRecords.h"

#include <array>

namespace pallax {

namespace {

using lte::ReselectionCandidate;
using Phase = Activity::Phase;

enum Layer : std::size_t { kLte, kOtherLte, kUtran, kGsm, k1x, kHrpd, kLayerCount };

constexpr unsigned kEarfcn = 1850;
constexpr unsigned kUplinkDistance = 18000;
constexpr unsigned kBand = 3;
constexpr unsigned kResourceBlocks = 100;
constexpr unsigned kServingPriority = 5;
constexpr int kQrxlevminDbm = -122;
constexpr int kLargestPowerDbm = 23;
/// Other carriers are searched below this level above Qrxlevmin.
constexpr int kSearchDb = 26;

/// Difference between measured and smoothed values.
constexpr double kLevelNoiseDb = 0.5;
constexpr double kQualityNoiseDb = 0.3;

/// The cell's share of the carrier; the more of the carrier is in use, the smaller.
double rsrq_db(const Scenario& scenario, double level_dbm) {
    constexpr double kAloneDb = -5.5;
    constexpr double kLoadDb = -3;
    return level_dbm - scenario.layer(kLte).total_dbm() + kAloneDb +
           kLoadDb * scenario.activity().load();
}

/// The whole carrier is stronger than one of its tones.
double rssi_dbm(double level_dbm, double quality_db) {
    constexpr double kResourceBlocksDb = 20;
    return level_dbm - quality_db + kResourceBlocksDb;
}

// A cell with a small share of the carrier is not found, and a found one is not always measured.
constexpr double kMeasuredBelowTotalDb = -10.5;
constexpr double kFoundBelowTotalDb = -14;

double belowTotal_db(const RadioLayer& layer, std::size_t cell) {
    return layer.level_dbm(cell) - layer.total_dbm();
}

/// The strongest neighbour can be measured; the others are weaker.
bool hasNeighbours(const RadioLayer& layer) {
    return !layer.neighbours().empty() &&
           belowTotal_db(layer, layer.neighbours().front()) > kMeasuredBelowTotalDb;
}

int srxlev_db(double level_dbm) {
    return whole(level_dbm) - kQrxlevminDbm;
}

void reportServing(const Scenario& scenario, Random& random, ByteBuffer& out) {
    const RadioLayer& layer = scenario.layer(kLte);
    const double level_dbm = layer.campedLevel_dbm();
    const double quality_db = rsrq_db(scenario, level_dbm);
    const int srxlev = srxlev_db(level_dbm);
    const bool searches = srxlev < kSearchDb;
    lte::IdleServing serving{};
    serving.earfcn = layer.campedCell().channel;
    serving.physicalCellId = layer.campedCell().code;
    serving.layerPriority = kServingPriority;
    serving.rsrp_dbm = measured(level_dbm, kLevelNoiseDb, random);
    serving.averageRsrp_dbm = level_dbm;
    serving.rsrq_db = measured(quality_db, kQualityNoiseDb, random);
    serving.averageRsrq_db = quality_db;
    serving.rssi_dbm = rssi_dbm(level_dbm, quality_db);
    serving.qrxlevmin_dbm = kQrxlevminDbm;
    serving.largestPower_dbm = kLargestPowerDbm;
    serving.ownLargestPower_dbm = kLargestPowerDbm;
    serving.srxlev_db = srxlev;
    serving.cyclesBelow = srxlev < 0 ? 1 : 0;
    serving.intraSearch_db = 62;
    serving.nonIntraSearch_db = kSearchDb;
    serving.rulesUpdated = searches;
    serving.rules = searches ? 2 : 1;
    lte::encode(serving, out);
}

void reportNeighbours(const Scenario& scenario, Random& random, ByteBuffer& out) {
    const RadioLayer& layer = scenario.layer(kLte);
    std::array<lte::IdleNeighbour, RadioLayer::kMostHeard> cells{};
    std::size_t count = 0;
    for (const std::size_t index : layer.neighbours()) {
        if (belowTotal_db(layer, index) <= kMeasuredBelowTotalDb) {
            break;
        }
        const Cell& cell = layer.cells()[index];
        const double level_dbm = layer.level_dbm(index);
        const double quality_db = rsrq_db(scenario, level_dbm);
        // The start of the cell's frames as heard here; constant while the cell is heard.
        constexpr unsigned kFrameLength = 1229;
        constexpr unsigned kSamplesPerFrame = 307200;
        cells[count++] = {cell.code,
                          rssi_dbm(level_dbm, quality_db),
                          measured(level_dbm, kLevelNoiseDb, random),
                          level_dbm,
                          measured(quality_db, kQualityNoiseDb, random),
                          quality_db,
                          srxlev_db(level_dbm),
                          cell.code % 13 + 20,
                          cell.identity % kFrameLength,
                          cell.identity * cell.code % kSamplesPerFrame};
    }
    lte::encode(lte::IdleNeighbours{kEarfcn, kQrxlevminDbm, std::span(cells.data(), count)}, out);
}

void reportConnected(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr std::size_t kMostMeasured = 6;
    constexpr std::size_t kMostDetected = 4;
    constexpr unsigned kSubframes = 10240;
    const RadioLayer& layer = scenario.layer(kLte);
    const auto levelsOf = [&](std::size_t index) {
        const double level_dbm = layer.level_dbm(index);
        return lte::ConnectedCell{layer.cells()[index].code,
                                  measured(level_dbm, kLevelNoiseDb, random),
                                  measured(rsrq_db(scenario, level_dbm), kQualityNoiseDb, random)};
    };
    std::array<lte::ConnectedCell, kMostMeasured> neighbours{};
    std::array<unsigned, kMostDetected> detected{};
    std::size_t measuredCount = 0;
    std::size_t detectedCount = 0;
    for (const std::size_t index : layer.neighbours()) {
        const double part_db = belowTotal_db(layer, index);
        if (part_db > kMeasuredBelowTotalDb && measuredCount < kMostMeasured) {
            neighbours[measuredCount++] = levelsOf(index);
        } else if (part_db > kFoundBelowTotalDb && detectedCount < kMostDetected) {
            detected[detectedCount++] = layer.cells()[index].code;
        }
    }
    // The report may come in any subframe of the step.
    const auto subframe =
        static_cast<unsigned>(scenario.now().count()) + random.below(Scenario::kStep.count());
    lte::encode(lte::ConnectedMeasurement{layer.campedCell().channel, subframe % kSubframes,
                                          levelsOf(layer.camped()),
                                          std::span(neighbours.data(), measuredCount),
                                          std::span(detected.data(), detectedCount)},
                out);
}

/// The cell of that layer, if one is heard.
std::span<const ReselectionCandidate> candidateOf(const Scenario& scenario, Layer layer,
                                                  ReselectionCandidate& candidate) {
    const RadioLayer& radio = scenario.layer(layer);
    const bool isHeard = layer == kLte ? hasNeighbours(radio) : radio.isHeard(radio.camped());
    if (!isHeard) {
        return {};
    }
    const Cell& cell =
        layer == kLte ? radio.cells()[radio.neighbours().front()] : radio.campedCell();
    candidate.channel = cell.channel;
    candidate.code = cell.code;
    return {&candidate, 1};
}

} // namespace

ScenarioPlan LteModem::plan() {
    ScenarioPlan plan;
    plan.layers.resize(kLayerCount);
    plan.layers[kLte] = {.firstChannel = kEarfcn,
                         .firstIdentity = 0x01980001,
                         .identityStep = 0x100,
                         .firstArea = 0x1A2B,
                         .sitesPerSide = 6,
                         .spacing_m = 800,
                         .power_dbm = 24,
                         .least_dbm = -112};
    const LayerPlan other = {.sitesPerSide = 4, .spacing_m = 1100, .updateEvery = 5};
    plan.layers[kOtherLte] = other;
    plan.layers[kOtherLte].firstChannel = 3300;
    plan.layers[kUtran] = other;
    plan.layers[kUtran].firstChannel = 10713;
    plan.layers[kUtran].codeCount = 512;
    plan.layers[kGsm] = other;
    plan.layers[kGsm].firstChannel = 20;
    plan.layers[kGsm].channelStep = 5;
    plan.layers[kGsm].channelCount = 16;
    plan.layers[kGsm].codeCount = 64;
    plan.layers[kGsm].power_dbm = 40;
    plan.layers[kGsm].least_dbm = -104;
    plan.layers[k1x] = other;
    plan.layers[k1x].firstChannel = 283;
    plan.layers[k1x].codeCount = 512;
    plan.layers[kHrpd] = other;
    plan.layers[kHrpd].firstChannel = 75;
    plan.layers[kHrpd].codeCount = 512;
    return plan;
}

void LteModem::observe(const Scenario& scenario, RecordQueue& queue) {
    const Activity& activity = scenario.activity();
    const Cell& cell = scenario.layer(kLte).campedCell();
    if (_simReading.isDue(scenario)) {
        encodePropertyList(kSimFilesCode, simFiles("LTE preferred", cell.area), ListForm::Xml,
                           queue.add());
    }
    if (scenario.now().count() == 0) {
        encodePropertyList(kPdpContextsCode, pdpContexts("ims", false), ListForm::Binary,
                           queue.add());
    }
    const bool updated = activity.hasChanged() && activity.phase() == Phase::Updating;
    if (scenario.hasNewServingCell() || updated) {
        lte::encode(lte::ServingCellInfo{cell.code, cell.channel, cell.channel + kUplinkDistance,
                                         kResourceBlocks, kResourceBlocks, cell.identity, cell.area,
                                         kBand},
                    queue.add());
        lte::encode(lte::AntennaReport{cell.identity / 0x100 % 3 == 0 ? 4U : 2U}, queue.add());
    }
    const bool sessionChanged = activity.hasChanged() && (activity.phase() == Phase::Connected ||
                                                          activity.phase() == Phase::Releasing);
    if (sessionChanged) {
        encodePropertyList(kPdpContextsCode, pdpContexts("ims", activity.isConnected()),
                           ListForm::Binary, queue.add());
    }
}

void LteModem::report(const Scenario& scenario, Random& random, ByteBuffer& out) {
    ReportMix<kKindCount>::Shares shares{};
    shares[kMonitor] = 1;
    if (scenario.activity().isConnected()) {
        shares[kConnected] = 78;
    } else {
        shares[kServing] = 34;
        shares[kNeighbours] = hasNeighbours(scenario.layer(kLte)) ? 28 : 0;
        shares[kCandidates] = 16;
    }
    switch (_mix.next(shares)) {
    case kServing:
        return reportServing(scenario, random, out);
    case kNeighbours:
        return reportNeighbours(scenario, random, out);
    case kCandidates:
        return reportCandidates(scenario, out);
    case kConnected:
        return reportConnected(scenario, random, out);
    default:
        return reportCellMonitor(scenario, out);
    }
}

void LteModem::reportCandidates(const Scenario& scenario, ByteBuffer& out) {
    using Technology = ReselectionCandidate::Technology;
    struct Turn {
        Layer layer;
        ReselectionCandidate candidate;
    };
    // Technology, priority, the cell's channel and code, band.
    constexpr std::array<Turn, 6> kTurns = {{
        {kLte, {Technology::Lte, kServingPriority, 0, 0, 0}},
        {kOtherLte, {Technology::Lte, 6, 0, 0, 0}},
        {kUtran, {Technology::Utran, 4, 0, 0, 0}},
        {kGsm, {Technology::Geran, 2, 0, 0, 8}},
        {k1x, {Technology::Cdma1xRtt, 1, 0, 0, 0}},
        {kHrpd, {Technology::CdmaHrpd, 1, 0, 0, 1}},
    }};
    Turn turn = kTurns[_candidateTurn++ % kTurns.size()];
    const Cell& serving = scenario.layer(kLte).campedCell();
    lte::encode(lte::ReselectionCandidates{serving.channel, serving.code,
                                           candidateOf(scenario, turn.layer, turn.candidate)},
                out);
}

void LteModem::reportCellMonitor(const Scenario& scenario, ByteBuffer& out) {
    const auto numberOf = [](const Cell& cell) { return std::int64_t{cell.code}; };
    const RadioLayer& layer = scenario.layer(kLte);
    const Cell& serving = layer.campedCell();
    const std::string_view technology = kHXCellMonitorRadioAccessTechnologyLTE;
    Array cells = {cellMonitorEntry(technology, CellRole::Serving,
                                    {{kHXCellMonitorPID, numberOf(serving)},
                                     {kHXCellMonitorUARFCN, serving.channel},
                                     {kHXCellMonitorTAC, serving.area},
                                     {kHXCellMonitorCellId, serving.identity},
                                     {kHXCellMonitorBandInfo, kBand}})};
    for (const std::size_t index : layer.neighbours()) {
        if (belowTotal_db(layer, index) <= kMeasuredBelowTotalDb) {
            break;
        }
        const Cell& cell = layer.cells()[index];
        cells.push_back(cellMonitorEntry(
            technology, CellRole::Neighbour,
            {{kHXCellMonitorPID, numberOf(cell)}, {kHXCellMonitorUARFCN, cell.channel}}));
    }
    const RadioLayer& gsm = scenario.layer(kGsm);
    if (gsm.isHeard(gsm.camped())) {
        cells.push_back(gsmNeighbourEntry(gsm.campedCell(), gsm.campedLevel_dbm()));
    }
    constexpr unsigned kFormTurn = 4;
    const ListForm form = ++_monitorTurn % kFormTurn == 0 ? ListForm::Xml : ListForm::Binary;
    encodePropertyList(kCellMonitorCode, cells, form, out);
}

} // namespace pallax
