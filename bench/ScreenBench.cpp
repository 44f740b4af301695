#include "app/PallaxPaneController.h"
#include "platform/ui/Window.h"
#include "ui/terminal/FrontEnd.h"

#include <benchmark/benchmark.h>

#include <memory>
#include <string>

namespace pallax {
namespace {

constexpr NumberFormat kDbm{"%d dBm"};
constexpr int kColumns = 80;
constexpr int kRows = 24;

class NoApplication final : public PaneApplication {
public:
    bool allowSaveButton() const override { return true; }
    void showSaveView() override {}
    ui::NavigationStack* navigationController() override { return stack; }

    ui::NavigationStack* stack = nullptr;
};

/// Sections of rows; every second value changes at each tick.
PropertyList displayOf(int sections, int rows, std::int64_t tick) {
    Dictionary display;
    for (int section = 0; section < sections; ++section) {
        Dictionary entries;
        for (int row = 0; row < rows; ++row) {
            const std::int64_t value = row % 2 == 0 ? tick : row;
            entries.set("Measured value " + std::to_string(row), DisplayNumber(value, kDbm));
        }
        display.set("Section " + std::to_string(section), std::move(entries));
    }
    return display;
}

/// From a display to the drawn screen: tree, reload of both panes, drawing. `filter` is typed into
/// the upper pane first.
void tick(benchmark::State& state, int sections, int rows, const std::string& filter) {
    const PropertyList displays[] = {displayOf(sections, rows, 1), displayOf(sections, rows, 2)};
    terminal::FrontEnd frontEnd({[] {}, [] {}, [](const std::string&) {}, [] {}},
                                terminal::kUtf8Marks);
    frontEnd.resize(kColumns, kRows);
    NoApplication application;
    const auto root =
        std::make_shared<PallaxPaneController>(frontEnd.toolkit(), application, nullptr, "/");
    const auto stack = frontEnd.toolkit().makeNavigationStack(root);
    application.stack = stack.get();
    const auto window = frontEnd.toolkit().makeWindow({});
    window->setRoot(*stack);
    window->makeKeyAndVisible();
    const std::string path = "/Section 0";
    const auto pane =
        std::make_shared<PallaxPaneController>(frontEnd.toolkit(), application, nullptr, path);
    stack->push(pane, false);
    if (!filter.empty()) {
        frontEnd.handle({terminal::Key::Character, U'/'});
        for (const char letter : filter) {
            frontEnd.handle({terminal::Key::Character, static_cast<char32_t>(letter)});
        }
    }
    std::size_t count = 0;
    for (auto _ : state) { // NOLINT: the library's way to count
        PathDictionary paths;
        root->reloadWithNode(PallaxModelNode::makeTreeFromObject(displays[++count % 2], paths));
        pane->reloadWithNode(paths.at(path));
        benchmark::DoNotOptimize(frontEnd.draw());
    }
}

void tickOfAUsualTree(benchmark::State& state) {
    tick(state, 11, 20, "");
}
BENCHMARK(tickOfAUsualTree)->Unit(benchmark::kMicrosecond);

void tickOf50000LeavesInSections(benchmark::State& state) {
    tick(state, 2500, 20, "");
}
BENCHMARK(tickOf50000LeavesInSections)->Unit(benchmark::kMillisecond);

void tickOf50000LeavesInOnePane(benchmark::State& state) {
    tick(state, 1, 50000, "");
}
BENCHMARK(tickOf50000LeavesInOnePane)->Unit(benchmark::kMillisecond);

void tickOf50000LeavesInOneFilteredPane(benchmark::State& state) {
    tick(state, 1, 50000, "value 4");
}
BENCHMARK(tickOf50000LeavesInOneFilteredPane)->Unit(benchmark::kMillisecond);

/// The cost as a function of the leaves in one pane.
void growingTick(benchmark::State& state) {
    tick(state, 1, static_cast<int>(state.range(0)), "");
}
BENCHMARK(growingTick)->RangeMultiplier(10)->Range(10, 100000)->Unit(benchmark::kMillisecond);

} // namespace
} // namespace pallax
