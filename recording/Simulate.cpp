#include "recording/Simulate.h"

#include "console/Progress.h"
#include "console/TerminalLine.h"
#include "host/Complaint.h"
#include "host/MonotonicClock.h"
#include "simulator/SimulatedRecording.h"

#include <chrono>
#include <unistd.h>

namespace pallax {

ExitStatus runSimulate(const SimulateOptions& options) {
    using Seconds = std::chrono::duration<double>;
    const Seconds whole = options.simulation.duration.value_or(std::chrono::seconds(1));
    const bool isData = options.file == "-" && ::isatty(STDOUT_FILENO) != 0;
    const MonotonicClock clock;
    TerminalLine line = TerminalLine::onStandardError();
    ProgressPace pace(clock);
    const auto tellProgress = [&](Time time) {
        if (pace.isDue()) {
            line.show(progressBar(Seconds(time - Simulation::kStart) / whole));
        }
    };
    const bool isShown = line.isPossible() && !isData;
    const auto error = isShown
                           ? writeSimulatedRecording(options.simulation, options.file, tellProgress)
                           : writeSimulatedRecording(options.simulation, options.file);
    line.wipe();
    if (!error || error->readerHasGone) {
        return kExitSuccess;
    }
    complain(error->sentence);
    return kExitFailure;
}

} // namespace pallax
