#include "cli/SimulateOptions.h"

#include "cli/OptionParts.h"
#include "host/Recording.h"

#include <cstdint>
#include <limits>
#include <string_view>

namespace pallax {

namespace {

constexpr const char* kDemoFooter = R"(Examples:
  pallax demo                          an LTE phone in a car
  pallax demo lte --seed 7 --speed 4   another car, four times as fast
  pallax demo --print --seconds 60 --speed max

The same seed gives the same drive. Without --seconds it runs until you quit.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: the simulated modem cannot be started, or has ended too early
  2   wrong usage)";

constexpr const char* kSimulateFooter = R"(Examples:
  pallax simulate lte --seconds 3600 --rate 50 -o hour.pcap
  pallax simulate lte --seconds 60 -o - | pallax decode -

The same technology, seed, rate and duration give the same file. An existing
file is replaced. On a terminal, runs of more than two seconds show their
progress.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: the recording cannot be written
  2   wrong usage)";

constexpr const char* kUntilWhen = "End after this many simulated seconds (default: never)";

CLI::Option* addSeed(CLI::App& app, const std::function<void(std::uint64_t)>& take) {
    return app
        .add_option_function<std::string>(
            "--seed",
            [take](const std::string& text) {
                take(numberOf<std::uint64_t>("--seed", text, 0,
                                             std::numeric_limits<std::uint64_t>::max()));
            },
            "Number of the drive; the same number gives the same packets (default: 1)")
        ->type_name("N");
}

CLI::Option* addRate(CLI::App& app, const std::function<void(unsigned)>& take) {
    // Fewer could not even carry the events.
    constexpr unsigned kLeast = 5;
    constexpr unsigned kMost = 1000000;
    return app
        .add_option_function<std::string>(
            "--rate",
            [take](const std::string& text) { take(numberOf("--rate", text, kLeast, kMost)); },
            "Packets per second (default: 40)")
        ->type_name("N");
}

CLI::Option* addSeconds(CLI::App& app, const std::function<void(std::chrono::seconds)>& take,
                        const std::string& description) {
    constexpr std::int64_t kMost = 366LL * 24 * 3600; // recordings have stamps until 2106
    return app
        .add_option_function<std::string>(
            "--seconds",
            [take](const std::string& text) {
                take(std::chrono::seconds(numberOf<std::int64_t>("--seconds", text, 1, kMost)));
            },
            description)
        ->type_name("N");
}

std::string simulatedNames() {
    std::string names;
    for (const RecordedTechnology* each : simulatedTechnologies()) {
        names += names.empty() ? "" : "|";
        names += each->commandName;
    }
    return names;
}

CLI::Option* addTechnology(CLI::App& app, const std::string& name,
                           const std::function<void(const RecordedTechnology*)>& take,
                           const std::string& description) {
    return app
        .add_option_function<std::string>(
            name,
            [take, name](const std::string& text) { take(simulatedTechnologyNamed(name, text)); },
            description)
        ->type_name(simulatedNames());
}

void addCommon(CLI::App& app, SimulationOptions& simulation) {
    addSeed(app, [&simulation](std::uint64_t seed) { simulation.seed = seed; });
    addRate(app, [&simulation](unsigned rate) { simulation.packetsPerSecond = rate; });
}

} // namespace

const RecordedTechnology* simulatedTechnologyNamed(const std::string& option,
                                                   const std::string& name) {
    for (const RecordedTechnology* each : simulatedTechnologies()) {
        if (each->commandName == name) {
            return each;
        }
    }
    throw unknownChoice(option, name, simulatedNames());
}

const RecordedTechnology* usualSimulatedTechnology() {
    return technologyOfCommandName("lte");
}

void addDemo(CLI::App& app, SimulationOptions& simulation, PlayOptions& play) {
    simulation.technology = usualSimulatedTechnology();
    addTechnology(
        app, "TECHNOLOGY",
        [&simulation](const RecordedTechnology* technology) { simulation.technology = technology; },
        "Technology of the simulated modem (default: lte)");
    addCommon(app, simulation);
    addSeconds(
        app, [&simulation](std::chrono::seconds duration) { simulation.duration = duration; },
        kUntilWhen);
    addSpeed(app, play);
    app.footer(kDemoFooter);
}

void addSimulate(CLI::App& app, SimulateOptions& options) {
    addTechnology(
        app, "TECHNOLOGY",
        [&options](const RecordedTechnology* technology) {
            options.simulation.technology = technology;
        },
        "Technology of the simulated modem")
        ->required();
    addSeconds(
        app, [&options](std::chrono::seconds duration) { options.simulation.duration = duration; },
        "Duration of the recording")
        ->required();
    addCommon(app, options.simulation);
    app.add_option("-o,--output", options.file, "The file to write; - is standard output")
        ->required()
        ->type_name("FILE");
    app.footer(kSimulateFooter);
}

CLI::Option* addServiceSimulation(CLI::App& app, Source& source) {
    const auto chosen = [&source]() -> SimulationOptions& {
        auto* simulation = std::get_if<SimulationOptions>(&source);
        return simulation != nullptr ? *simulation : source.emplace<SimulationOptions>();
    };
    CLI::Option* technology = addTechnology(
        app, "--simulate",
        [chosen](const RecordedTechnology* named) { chosen().technology = named; },
        "The modem to simulate for each viewer");
    addSeed(app, [chosen](std::uint64_t seed) { chosen().seed = seed; })->needs(technology);
    addRate(app, [chosen](unsigned rate) { chosen().packetsPerSecond = rate; })->needs(technology);
    addSeconds(
        app, [chosen](std::chrono::seconds duration) { chosen().duration = duration; }, kUntilWhen)
        ->needs(technology);
    return technology;
}

} // namespace pallax
