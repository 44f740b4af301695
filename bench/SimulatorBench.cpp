// Packets per second of each simulated modem, at 50 per second of simulated time, and for an hour
// of LTE written as a recording.

#include "host/Recording.h"
#include "simulator/SimulatedRecording.h"
#include "simulator/Simulation.h"

#include <benchmark/benchmark.h>

namespace pallax {
namespace {

constexpr unsigned kRate = 50;

void simulate(benchmark::State& state, const char* commandName) {
    SimulationOptions options;
    options.technology = technologyOfCommandName(commandName);
    options.packetsPerSecond = kRate;
    Simulation simulation(options);
    for (auto _ : state) {
        benchmark::DoNotOptimize(simulation.next());
    }
    state.SetItemsProcessed(state.iterations());
}

void writeHour(benchmark::State& state) {
    constexpr std::chrono::seconds kHour{3600};
    SimulationOptions options;
    options.technology = technologyOfCommandName("lte");
    options.packetsPerSecond = kRate;
    options.duration = kHour;
    for (auto _ : state) {
        if (const auto error = writeSimulatedRecording(options, "/dev/null")) {
            state.SkipWithError(error->sentence.c_str());
        }
    }
    state.SetItemsProcessed(state.iterations() * kHour.count() * kRate);
}

BENCHMARK_CAPTURE(simulate, ifx, "ifx");
BENCHMARK_CAPTURE(simulate, gsm, "gsm");
BENCHMARK_CAPTURE(simulate, cdma, "cdma");
BENCHMARK_CAPTURE(simulate, lte, "lte");
BENCHMARK_CAPTURE(simulate, utran, "utran");
BENCHMARK(writeHour)->Unit(benchmark::kMillisecond);

} // namespace
} // namespace pallax
