#pragma once

#include "tests/simulator/SimulatedPhone.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <map>
#include <string>
#include <vector>

/// Many drives of a technology, checked packet by packet.
namespace pallax {

/// The state of a drive after a packet was decoded.
struct DriveMoment {
    const DecodedDisplay& decoded;
    std::uint32_t code; ///< 0 in an object stream
    Time time;
    std::uint64_t seed;
};

struct DriveOptions {
    std::string_view technology;
    std::chrono::seconds duration;
    unsigned packetsPerSecond; ///< few, because each packet is decoded; the drive is the same
};

/// Calls `check` after each packet, until a drive fails.
inline void inEveryDrive(const DriveOptions& options,
                         const std::function<void(const DriveMoment&)>& check) {
    constexpr std::uint64_t kSeeds = PALLAX_DRIVES;
    for (std::uint64_t seed = 0; seed < kSeeds && !testing::Test::HasFailure(); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        DecodedDisplay decoded(options.technology);
        SimulationOptions simulated = simulationOf(options.technology, seed, options.duration);
        simulated.packetsPerSecond = options.packetsPerSecond;
        Simulation simulation(simulated);
        while (const auto packet = simulation.next()) {
            decoded.feed(packet->data);
            const bool isRecord = options.technology != "ifx";
            check(
                {decoded,
                 isRecord ? LogPacketGetLogCode(LogRecord(LogPacketStripPrefix(packet->data))) : 0,
                 packet->time, seed});
        }
    }
}

inline bool contains(const std::vector<std::string>& list, const std::string& text) {
    return std::find(list.begin(), list.end(), text) != list.end();
}

/// A shown quantity, with one curve for each cell or channel.
class Curve {
public:
    /// Values must lie between `least` and `most`, and reports less than two scenario steps apart
    /// must not differ by more than `largestStep`.
    Curve(std::string name, double least, double most, double largestStep)
        : _name(std::move(name)), _least(least), _most(most), _largestStep(largestStep) {}

    void see(const DriveMoment& moment, const std::string& of, const std::string& shown) {
        const double value = numberOf(shown);
        ++_seen;
        EXPECT_TRUE(value >= _least && value <= _most) << _name << " of " << of << ": " << shown;
        const auto last = _last.find(of);
        if (last != _last.end() && last->second.seed == moment.seed &&
            moment.time - last->second.time < 2 * Scenario::kStep) {
            ++_compared;
            EXPECT_LE(std::abs(value - last->second.value), _largestStep)
                << _name << " of " << of << " jumps from " << last->second.value << " to " << value;
        }
        _last.insert_or_assign(of, Point{moment.seed, moment.time, value});
    }
    std::size_t seen() const { return _seen; }
    /// The number of reports that were close enough to the one before to be compared with it.
    std::size_t compared() const { return _compared; }

private:
    struct Point {
        std::uint64_t seed;
        Time time;
        double value;
    };

    std::string _name;
    double _least;
    double _most;
    double _largestStep;
    std::size_t _seen = 0;
    std::size_t _compared = 0;
    std::map<std::string, Point> _last;
};

/// Fails if a level is above the one before by more than `apart`, the noise of two measurements.
inline void expectStrongestFirst(const std::vector<std::string>& levels, double apart) {
    for (std::size_t index = 1; index < levels.size(); ++index) {
        EXPECT_LE(numberOf(levels[index]), numberOf(levels[index - 1]) + apart)
            << "neighbour " << index;
    }
}

} // namespace pallax
