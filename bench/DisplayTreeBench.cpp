#include "app/tree/PallaxModelNode.h"
#include "monitor/Frame.h"

#include <benchmark/benchmark.h>

namespace pallax {
namespace {

constexpr NumberFormat kDbm{"%d dBm"};

/// Sections of display numbers and labels, as records fill them.
PropertyList displayOf(int sections, int rows) {
    Dictionary display;
    for (int section = 0; section < sections; ++section) {
        Dictionary entries;
        for (int row = 0; row < rows; ++row) {
            const std::string key = "Measured value " + std::to_string(row);
            if (row % 2 == 0) {
                entries.set(key, DisplayNumber(std::int64_t{row}, kDbm));
            } else {
                entries.set(key, Text::fixed("Camped normally"));
            }
        }
        display.set("Section " + std::to_string(section), std::move(entries));
    }
    return display;
}

void buildTree(benchmark::State& state, const PropertyList& display) {
    std::size_t nodes = 0;
    for (auto _ : state) { // NOLINT: the library's way to count
        PathDictionary paths;
        benchmark::DoNotOptimize(PallaxModelNode::makeTreeFromObject(display, paths));
        nodes += paths.size();
    }
    state.SetItemsProcessed(static_cast<std::int64_t>(nodes));
}

/// The tree, and the frame that compares it with that of the tick before.
void buildFrame(benchmark::State& state, const PropertyList& display) {
    std::size_t nodes = 0;
    FrameRef frame;
    for (auto _ : state) { // NOLINT: the library's way to count
        auto paths = std::make_shared<PathDictionary>();
        NodeRef root = PallaxModelNode::makeTreeFromObject(display, *paths);
        nodes += paths->size();
        frame = std::make_shared<Frame>(Frame::Picture{std::move(root), std::move(paths), Time()},
                                        frame.get(), nullptr);
    }
    state.SetItemsProcessed(static_cast<std::int64_t>(nodes));
}

/// What a display tick builds: 11 sections of 20 leaves.
void treeOfOneTick(benchmark::State& state) {
    buildTree(state, displayOf(11, 20));
}
BENCHMARK(treeOfOneTick);

void frameOfOneTick(benchmark::State& state) {
    buildFrame(state, displayOf(11, 20));
}
BENCHMARK(frameOfOneTick);

/// 50,000 leaves in one list of cells.
PropertyList cellsOf50000Leaves() {
    Array cells;
    for (int cell = 0; cell < 2500; ++cell) {
        cells.push_back(*displayOf(1, 20).dictionary()->find("Section 0"));
    }
    return Dictionary{{"Cells", std::move(cells)}};
}

void treeOf50000Leaves(benchmark::State& state) {
    buildTree(state, cellsOf50000Leaves());
}
BENCHMARK(treeOf50000Leaves);

void frameOf50000Leaves(benchmark::State& state) {
    buildFrame(state, cellsOf50000Leaves());
}
BENCHMARK(frameOf50000Leaves);

/// 50,000 leaves of one sorted dictionary, whose names are cut from their keys.
void treeOf50000SortedLeaves(benchmark::State& state) {
    Dictionary entries{{"_sorted", "1"}};
    for (int row = 0; row < 50000; ++row) {
        entries.set(std::to_string(row) + ";" + std::to_string(row % 512), Text::fixed("Active"));
    }
    buildTree(state, entries);
}
BENCHMARK(treeOf50000SortedLeaves);

} // namespace
} // namespace pallax
