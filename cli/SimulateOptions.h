#pragma once

#include "recording/Simulate.h"
#include "sources/Source.h"
#include "telephony/PacketPlayer.h"

namespace CLI {
class App;
class Option;
} // namespace CLI

namespace pallax {

/// The technology that `demo` shows when none is named.
const RecordedTechnology* usualSimulatedTechnology();

/// Adds the options of demo: `[TECHNOLOGY] --seed --rate --seconds --speed`.
void addDemo(CLI::App& app, SimulationOptions& simulation, PlayOptions& play);
/// Adds `TECHNOLOGY --seconds N --seed --rate -o FILE`.
void addSimulate(CLI::App& app, SimulateOptions& options);
/// Adds `--simulate TECHNOLOGY --seed --rate --seconds`, which make the source a simulation;
/// returns the first.
CLI::Option* addServiceSimulation(CLI::App& app, Source& source);

} // namespace pallax
