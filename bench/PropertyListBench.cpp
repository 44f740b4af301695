// Reading and writing a cell-monitor array of 200 cells, the largest list that the telephony
// service sends every few seconds.

#include "plist/PropertyListCodec.h"

#include <benchmark/benchmark.h>

#include <cstdint>
#include <string>

namespace pallax {
namespace {

constexpr int kCells = 200;

PropertyList cell(std::int64_t number) {
    const bool serving = number == 0;
    return Dictionary{
        {"kHXCellMonitorCellRadioAccessTechnology", "kHXCellMonitorRadioAccessTechnologyLTE"},
        {"kHXCellMonitorCellType",
         serving ? "kHXCellMonitorCellTypeServing" : "kHXCellMonitorCellTypeNeighbor"},
        {"kHXCellMonitorMCC", PropertyList::integer(262)},
        {"kHXCellMonitorMNC", PropertyList::integer(1)},
        {"kHXCellMonitorTAC", PropertyList::integer(4660 + number)},
        {"kHXCellMonitorCellId", PropertyList::integer(12345678 + number * 7)},
        {"kHXCellMonitorPID", PropertyList::integer(number % 504)},
        {"kHXCellMonitorBandInfo", PropertyList::integer(3)},
        {"kHXCellMonitorUARFCN", PropertyList::integer(1850 + number)},
    };
}

PropertyList cellMonitorArray() {
    Array cells;
    for (int number = 0; number < kCells; ++number) {
        cells.push_back(cell(number));
    }
    return cells;
}

std::string textForm() {
    std::string text = "(\n";
    const PropertyList cells = cellMonitorArray();
    for (const PropertyList& each : *cells.array()) {
        text += each.description() + ",\n";
    }
    return text + ")\n";
}

void read(benchmark::State& state, const ByteBuffer& bytes) {
    if (!parsePropertyList(bytes)) {
        state.SkipWithError("the list does not read");
    }
    for ([[maybe_unused]] const auto turn : state) {
        benchmark::DoNotOptimize(parsePropertyList(bytes));
    }
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(bytes.size()));
    state.SetItemsProcessed(state.iterations() * kCells);
}

void readXml(benchmark::State& state) {
    const std::string xml = *serializeXml(cellMonitorArray());
    read(state, {xml.begin(), xml.end()});
}
BENCHMARK(readXml);

void readBinary(benchmark::State& state) {
    read(state, *serializeBinary(cellMonitorArray()));
}
BENCHMARK(readBinary);

void readText(benchmark::State& state) {
    const std::string text = textForm();
    read(state, {text.begin(), text.end()});
}
BENCHMARK(readText);

void writeXml(benchmark::State& state) {
    const PropertyList cells = cellMonitorArray();
    for ([[maybe_unused]] const auto turn : state) {
        benchmark::DoNotOptimize(serializeXml(cells));
    }
    state.SetItemsProcessed(state.iterations() * kCells);
}
BENCHMARK(writeXml);

void writeBinary(benchmark::State& state) {
    const PropertyList cells = cellMonitorArray();
    for ([[maybe_unused]] const auto turn : state) {
        benchmark::DoNotOptimize(serializeBinary(cells));
    }
    state.SetItemsProcessed(state.iterations() * kCells);
}
BENCHMARK(writeBinary);

} // namespace
} // namespace pallax
