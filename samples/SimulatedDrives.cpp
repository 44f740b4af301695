#include "host/Recording.h"
#include "samples/Sample.h"
#include "simulator/Simulation.h"

#include <chrono>

// Drives of the simulated modem; the seeds were chosen so that the drives show as much as possible.

namespace pallax {

namespace {

using std::chrono::seconds;

std::vector<TimedPacket> drive(std::string_view technology, std::uint64_t seed, seconds duration,
                               unsigned packetsPerSecond) {
    SimulationOptions options;
    options.technology = technologyOfCommandName(technology);
    options.seed = seed;
    options.duration = duration;
    options.packetsPerSecond = packetsPerSecond;
    Simulation simulation(options);
    std::vector<TimedPacket> packets;
    while (const auto packet = simulation.next()) {
        packets.push_back({packet->time, ByteBuffer(packet->data.begin(), packet->data.end())});
    }
    return packets;
}

} // namespace

static_assert(Simulation::kStart == kSampleStart);

std::vector<TimedPacket> cdmaDrivePackets() {
    return drive("cdma", 25, seconds(60), 12);
}

std::vector<TimedPacket> lteDrivePackets() {
    return drive("lte", 8, seconds(120), 10);
}

std::vector<TimedPacket> utranDrivePackets() {
    return drive("utran", 13, seconds(120), 6);
}

} // namespace pallax
