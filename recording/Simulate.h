#pragma once

#include "console/ExitStatus.h"
#include "simulator/Simulation.h"

#include <string>

namespace pallax {

/// `pallax simulate`: a simulation, which has a duration, as a recording.
struct SimulateOptions {
    SimulationOptions simulation;
    std::string file; ///< "-" is standard output
};

/// Reports on standard error.
ExitStatus runSimulate(const SimulateOptions& options);

} // namespace pallax
