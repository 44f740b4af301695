#include "simulator/Measurement.h"
#include "simulator/gsm/GsmModem.h"
#include "simulator/gsm/GsmReports.h"
#include "simulator/gsm/UmtsRecords.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace pallax::gsm {

namespace {

constexpr double kUmtsNoiseDb = 0.6;
constexpr double kLeastEcnoDb = -20;
constexpr std::size_t kMostCells = 6;

/// Ec/No of the cells that the searcher finds, the serving cell first.
template <class Visit>
void visitCells(const Scenario& scenario, Visit visit) {
    const RadioLayer& layer = scenario.layer(GsmModem::kUmts);
    if (!layer.isHeard(layer.camped())) {
        return;
    }
    visit(layer.camped());
    std::size_t count = 1;
    for (const std::size_t index : layer.neighbours()) {
        if (count++ < kMostCells && ecno_db(scenario, layer.level_dbm(index)) > kLeastEcnoDb) {
            visit(index);
        }
    }
}

/// The weaker the cell, the more blocks are lost.
double blockErrorRate(const Scenario& scenario) {
    const RadioLayer& layer = scenario.layer(GsmModem::kUmts);
    const double ecno = ecno_db(scenario, layer.campedLevel_dbm());
    constexpr double kGoodDb = -5;
    constexpr double kRatePerDb = 0.012;
    return std::clamp((kGoodDb - ecno) * kRatePerDb, 0.005, 0.3);
}

std::uint32_t errorsOf(std::uint32_t blocks, const Scenario& scenario, Random& random) {
    const double expected = blocks * blockErrorRate(scenario);
    const double found = std::max(expected + random.normal() * std::sqrt(expected), 0.0);
    return std::min(static_cast<std::uint32_t>(found), blocks);
}

} // namespace

double ecno_db(const Scenario& scenario, double level_dbm) {
    constexpr double kAloneDb = -3;
    constexpr double kLoadDb = -3;
    return level_dbm - scenario.layer(GsmModem::kUmts).total_dbm() + kAloneDb +
           kLoadDb * scenario.activity().load();
}

void reportSearcher(const Scenario& scenario, Random& random, ByteBuffer& out) {
    const RadioLayer& layer = scenario.layer(GsmModem::kUmts);
    const double carrier_dbm = layer.campedLevel_dbm() - ecno_db(scenario, layer.campedLevel_dbm());
    const bool serves = scenario.servingLayer() == GsmModem::kUmts;
    std::array<SearchedCell, kMostCells> cells{};
    std::size_t count = 0;
    visitCells(scenario, [&](std::size_t index) {
        const double ecno = ecno_db(scenario, layer.level_dbm(index));
        cells[count++] = {layer.cells()[index].code, serves && index == layer.camped(),
                          std::clamp(whole(measured(ecno, kUmtsNoiseDb, random)), -22, -1)};
    });
    encode(Searcher{whole(carrier_dbm), std::span(cells.data(), count)}, out);
}

void reportUmtsRanking(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr int kLeastRankDbm = -115;
    const RadioLayer& layer = scenario.layer(GsmModem::kUmts);
    std::array<RankedUmtsCell, kMostCells> cells{};
    std::size_t count = 0;
    visitCells(scenario, [&](std::size_t index) {
        const Cell& cell = layer.cells()[index];
        const int rscp = whole(measured(layer.level_dbm(index), kUmtsNoiseDb, random));
        const double ecno =
            measured(ecno_db(scenario, layer.level_dbm(index)), kUmtsNoiseDb, random);
        cells[count++] = {cell.channel, cell.code, rscp, whole(2 * std::min(ecno, -0.5)) / 2.0,
                          rscp - kLeastRankDbm};
    });
    encode(std::span<const RankedUmtsCell>(cells.data(), count), out);
}

void reportTransmitPower(const Scenario& scenario, Random& random, ByteBuffer& out) {
    // Open-loop power control: the weaker the cell, the higher the power.
    constexpr double kSumOfBothDbm = -88;
    constexpr double kLargestDbm = 23;
    constexpr double kLeastDbm = -50;
    const double power_dbm =
        std::clamp(kSumOfBothDbm - scenario.layer(GsmModem::kUmts).campedLevel_dbm() +
                       scenario.activity().load() * 6,
                   kLeastDbm, kLargestDbm);
    std::array<int, 4> slots{};
    for (int& slot : slots) {
        slot = whole(std::min(measured(power_dbm, 1.0, random), kLargestDbm));
    }
    encode(TransmitPower{slots}, out);
}

void reportBlockErrors(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr unsigned kWindow = 200;
    std::array<ChannelBlocks, 2> channels{};
    unsigned number = 1;
    for (ChannelBlocks& channel : channels) {
        const std::uint32_t received = kWindow / number - random.below(8);
        channel = {number, received, errorsOf(received, scenario, random)};
        ++number;
    }
    encode(BlockErrors{kWindow, channels}, out);
}

void reportHsdpa(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr unsigned kSubFrames = 100;
    constexpr double kBitsPerTransmission = 11000;
    constexpr std::size_t kProcesses = 6;
    constexpr unsigned kTurns = kSubFrames / kProcesses; // of a process, rounded down
    // Two carriers at high load.
    constexpr double kSecondCarrierLoad = 0.6;
    const double load = scenario.activity().load();
    const bool dual = load > kSecondCarrierLoad;
    const auto process = [&](unsigned id) {
        const auto transmissions = static_cast<unsigned>(kTurns * load + random.between(0, 2));
        const double bits = transmissions * kBitsPerTransmission * random.between(0.9, 1.0);
        return HarqProcess{id, static_cast<std::uint32_t>(bits), transmissions,
                           errorsOf(transmissions, scenario, random)};
    };
    std::array<HarqProcess, kProcesses> primary{};
    std::array<HarqProcess, kProcesses> secondary{};
    for (unsigned id = 0; id < kProcesses; ++id) {
        primary[id] = process(id);
        secondary[id] = process(id);
    }
    encode(Hsdpa{kSubFrames, dual ? Hsdpa::Carriers::Dual : Hsdpa::Carriers::Single, primary,
                 std::span(secondary).first(dual ? kProcesses : 0)},
           out);
}

} // namespace pallax::gsm
