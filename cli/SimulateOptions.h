#pragma once

#include "simulator/Simulation.h"
#include "telephony/PacketPlayer.h"

#include <optional>
#include <string>

namespace CLI {
class App;
class Option;
} // namespace CLI

namespace pallax {

/// `pallax simulate`: a simulation, which has a duration, as a recording.
struct SimulateOptions {
    SimulationOptions simulation;
    std::string file; ///< "-" is standard output
};

/// The technology that `demo` shows when none is named.
const RecordedTechnology* usualSimulatedTechnology();

/// The options that begin a simulation's: `[TECHNOLOGY] --seed --rate --seconds --speed`.
void addDemo(CLI::App& app, SimulationOptions& simulation, PlayOptions& play);
/// `TECHNOLOGY --seconds N --seed --rate -o FILE`.
void addSimulate(CLI::App& app, SimulateOptions& options);
/// `--simulate TECHNOLOGY --seed --rate --seconds`; the first of them.
CLI::Option* addServiceSimulation(CLI::App& app, std::optional<SimulationOptions>& simulation);

} // namespace pallax
