#pragma once

#include "simulator/Modem.h"
#include "simulator/Random.h"
#include "simulator/Scenario.h"
#include "text/Bytes.h"
#include "text/Date.h"

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string_view>

namespace pallax {

struct RecordedTechnology;

/// The options of a simulation.
struct SimulationOptions {
    static constexpr unsigned kUsualRate = 40;

    const RecordedTechnology* technology = nullptr; ///< one of `simulatedTechnologies`
    std::uint64_t seed = 1;
    unsigned packetsPerSecond = kUsualRate;       ///< at least 1
    std::optional<std::chrono::seconds> duration; ///< if missing, it never ends
};

/// The technologies that can be simulated, in the order in which they are offered.
std::span<const RecordedTechnology* const> simulatedTechnologies();

/// The packets of a simulated modem, endlessly. The same options give the same packets at the same
/// times; the rate changes how often the modem reports, not what happens.
class Simulation {
public:
    /// The start of every simulation: 2023-11-14 22:13:20 UTC.
    static constexpr Time kStart{std::chrono::seconds{1700000000}};

    struct Packet {
        Time time;
        Bytes data; ///< valid until the next call
    };

    explicit Simulation(const SimulationOptions& options);

    /// Nothing after the duration.
    std::optional<Packet> next();

private:
    Time nextTime();

    SimulationOptions _options;
    std::unique_ptr<Modem> _modem;
    Scenario _scenario;
    Random _reports;
    RecordQueue _queue;
    ByteBuffer _record;
    std::chrono::nanoseconds _slot; // average time between packets
    std::uint64_t _count = 0;
};

} // namespace pallax
