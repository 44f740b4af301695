#include "simulator/Simulation.h"

#include "host/Recording.h"
#include "simulator/RecordWriter.h"
#include "simulator/cdma/CdmaModem.h"
#include "simulator/gsm/GsmModem.h"
#include "simulator/ifx/IfxModem.h"
#include "simulator/lte/LteModem.h"
#include "simulator/utran/UtranModem.h"

#include <array>
#include <stdexcept>

namespace pallax {

namespace {

/// Makes the measurement noise independent of the scenario's random numbers.
constexpr std::uint64_t kReportSeed = 0x5EED0FF5E7;

struct SimulatedTechnology {
    const RecordedTechnology* technology;
    ScenarioPlan (*plan)();
    std::unique_ptr<Modem> (*modem)();
};

template <class TechnologyModem>
SimulatedTechnology simulated(std::string_view commandName) {
    return {technologyOfCommandName(commandName), TechnologyModem::plan,
            []() -> std::unique_ptr<Modem> { return std::make_unique<TechnologyModem>(); }};
}

const auto& table() {
    static const auto technologies = std::to_array<SimulatedTechnology>({
        simulated<IfxModem>("ifx"),
        simulated<GsmModem>("gsm"),
        simulated<CdmaModem>("cdma"),
        simulated<LteModem>("lte"),
        simulated<UtranModem>("utran"),
    });
    return technologies;
}

const SimulatedTechnology& entryOf(const RecordedTechnology* technology) {
    for (const SimulatedTechnology& each : table()) {
        if (each.technology == technology && technology != nullptr) {
            return each;
        }
    }
    throw std::invalid_argument("No such technology can be simulated.");
}

} // namespace

std::span<const RecordedTechnology* const> simulatedTechnologies() {
    static const auto names = [] {
        std::vector<const RecordedTechnology*> list;
        for (const SimulatedTechnology& each : table()) {
            list.push_back(each.technology);
        }
        return list;
    }();
    return names;
}

Simulation::Simulation(const SimulationOptions& options)
    : _options(options), _modem(entryOf(options.technology).modem()),
      _scenario(entryOf(options.technology).plan(), options.seed),
      _reports(options.seed ^ kReportSeed),
      _slot(std::chrono::nanoseconds(std::chrono::seconds(1)) / options.packetsPerSecond) {
    _modem->observe(_scenario, _queue);
}

std::optional<Simulation::Packet> Simulation::next() {
    const Time time = nextTime();
    if (_options.duration && time >= kStart + *_options.duration) {
        return std::nullopt;
    }
    while (kStart + _scenario.now() + Scenario::kStep <= time) {
        _scenario.step();
        _modem->observe(_scenario, _queue);
    }
    if (_queue.empty()) {
        _modem->report(_scenario, _reports, _record);
    } else {
        _queue.take(_record);
    }
    if (_modem->sendsRecords()) {
        const auto stamp =
            std::chrono::duration_cast<std::chrono::microseconds>(time.time_since_epoch());
        stampRecord(_record, static_cast<std::uint64_t>(stamp.count()));
    }
    return Packet{time, _record};
}

/// Packets are irregular but in order.
Time Simulation::nextTime() {
    constexpr double kUnrest = 0.6; // relative to the time between two packets
    const auto delay =
        static_cast<std::int64_t>(_reports.unit() * kUnrest * static_cast<double>(_slot.count()));
    return kStart + _slot * static_cast<std::int64_t>(_count++) + std::chrono::nanoseconds(delay);
}

} // namespace pallax
