#include "simulator/SimulatedRecording.h"

#include "host/Recording.h"
#include "host/RecordingWriter.h"

namespace pallax {

std::optional<HostError> writeSimulatedRecording(const SimulationOptions& options,
                                                 const std::string& path,
                                                 const std::function<void(Time time)>& written) {
    auto writer = RecordingWriter::create(path, options.technology->linkType,
                                          RecordingWriter::Flush::InBlocks);
    if (!writer) {
        return writer.error();
    }
    Simulation simulation(options);
    while (const auto packet = simulation.next()) {
        if (auto error = (*writer)->write(packet->time, packet->data)) {
            return error;
        }
        if (written) {
            written(packet->time);
        }
    }
    return (*writer)->flush();
}

} // namespace pallax
