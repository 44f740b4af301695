#pragma once

#include "recording/Simulate.h"
#include "sources/Source.h"
#include "telephony/PacketPlayer.h"

#include <string>

namespace CLI {
class App;
class Option;
} // namespace CLI

namespace pallax {

/// The technology that `demo` shows when none is named.
const RecordedTechnology* usualSimulatedTechnology();

/// The one with this name; throws, with the name of the option, if it cannot be simulated.
const RecordedTechnology* simulatedTechnologyNamed(const std::string& option,
                                                   const std::string& name);

/// Adds the options of demo: `[TECHNOLOGY] --seed --rate --seconds --speed`.
void addDemo(CLI::App& app, SimulationOptions& simulation, PlayOptions& play);
/// Adds `TECHNOLOGY --seconds N --seed --rate -o FILE`.
void addSimulate(CLI::App& app, SimulateOptions& options);
/// Adds `--simulate TECHNOLOGY --seed --rate --seconds`, which make the source a simulation;
/// returns the first.
CLI::Option* addServiceSimulation(CLI::App& app, Source& source);

} // namespace pallax
