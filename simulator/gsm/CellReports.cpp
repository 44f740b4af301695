#include "simulator/Measurement.h"
#include "simulator/gsm/GsmModem.h"
#include "simulator/gsm/GsmRecords.h"
#include "simulator/gsm/GsmReports.h"
#include "simulator/gsm/UmtsRecords.h"

#include <algorithm>
#include <array>

namespace pallax::gsm {

namespace {

constexpr double kNoiseDb = 0.7;
constexpr int kLeastAccessDbm = -105;
constexpr std::size_t kMostNeighbours = 6;

std::span<const std::size_t> neighboursOf(const Scenario& scenario) {
    const auto all = scenario.layer(GsmModem::kGsm).neighbours();
    return all.first(std::min(all.size(), kMostNeighbours));
}

int levelOf(const RadioLayer& layer, std::size_t cell, Random& random) {
    return whole(measured(layer.level_dbm(cell), kNoiseDb, random));
}

} // namespace

void reportMeasurement(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr int kReselectOffsetDb = 6;
    const RadioLayer& layer = scenario.layer(GsmModem::kGsm);
    std::array<NeighbourLevel, kMostNeighbours> cells{};
    std::size_t count = 0;
    for (const std::size_t index : neighboursOf(scenario)) {
        const int level_dbm = levelOf(layer, index, random);
        cells[count++] = {layer.cells()[index].channel, level_dbm, level_dbm - kLeastAccessDbm};
    }
    const int level_dbm = levelOf(layer, layer.camped(), random);
    const int c1 = std::max(level_dbm - kLeastAccessDbm, 0);
    encode(CellMeasurement{level_dbm, c1, c1 + kReselectOffsetDb, true,
                           std::span(cells.data(), count)},
           out);
}

void reportBsics(const Scenario& scenario, ByteBuffer& out) {
    const RadioLayer& layer = scenario.layer(GsmModem::kGsm);
    std::array<NeighbourBsic, kMostNeighbours> cells{};
    std::size_t count = 0;
    for (const std::size_t index : neighboursOf(scenario)) {
        cells[count++] = {layer.cells()[index].channel, layer.cells()[index].code};
    }
    encode(BsicList{std::span(cells.data(), count)}, out);
}

void reportGsmRanking(const Scenario& scenario, Random& random, ByteBuffer& out) {
    const RadioLayer& layer = scenario.layer(GsmModem::kGsm);
    std::array<RankedGsmCell, kMostNeighbours + 1> cells{};
    std::size_t count = 0;
    const auto add = [&](std::size_t index) {
        const Cell& cell = layer.cells()[index];
        const int level_dbm = levelOf(layer, index, random);
        cells[count++] = {cell.channel, cell.code, level_dbm, level_dbm - kLeastAccessDbm};
    };
    add(layer.camped());
    for (const std::size_t index : neighboursOf(scenario)) {
        add(index);
    }
    encode(std::span<const RankedGsmCell>(cells.data(), count), out);
}

} // namespace pallax::gsm
