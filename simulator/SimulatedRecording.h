#pragma once

#include "host/HostError.h"
#include "simulator/Simulation.h"

#include <functional>
#include <optional>
#include <string>

namespace pallax {

/// Writes a simulation with a duration as a recording to `path` ("-" is standard output), replacing
/// an existing file. Returns an error on failure. `written`, if any, receives each packet's time.
std::optional<HostError>
writeSimulatedRecording(const SimulationOptions& options, const std::string& path,
                        const std::function<void(Time time)>& written = {});

} // namespace pallax
