#include "cli/Options.h"

#include "cli/OptionParts.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kVersionText = "pallax " PALLAX_VERSION;

constexpr const char* kFooter = R"(Examples:
  pallax                               browse the live modem
  pallax drive.pcap --speed 4          browse a recording, four times as fast
  modem-dump | pallax -                browse what another program records
  pallax demo                          browse a simulated modem
  pallax decode drive.pcap             its last display as JSON
  pallax decode --every tick --format csv drive.pcap > drive.csv
  pallax service --play drive.pcap     let viewers connect to a played recording

A recording that is named like a command is given with its folder: pallax ./decode

Exit status: 0 success, 1 failure, 2 wrong usage, 70 ended by a fatal record.)";

constexpr const char* kDecodeFooter = R"(Examples:
  pallax decode drive.pcap
  pallax decode --every tick drive.pcap | jq .display
  pallax decode --every packet --format csv --technology lte raw.pcap
  pallax decode --system-log drive.log drive.pcap

Ticks are 2.0 s of recording time apart, counted from the first packet. "-" is standard input.)";

constexpr const char* kServiceFooter = R"(Examples:
  pallax service --play drive.pcap
  pallax service --play drive.pcap --speed max --loop
  pallax service --simulate lte --seed 7)";

void addPlay(CLI::App& app, PlayOptions& play, CLI::Option* recording) {
    addSpeed(app, play)->needs(recording);
    app.add_flag("--loop", play.loop, "Begin again at the recording's end")->needs(recording);
}

/// What is common to all ways of browsing.
void addView(CLI::App& app, BrowseOptions& options) {
    constexpr int kHighestLevel = 7;
    app.add_flag("--print", options.print,
                 "Print the tree as text at each display tick, as is done without a terminal");
    addChoice<terminal::ColorUse>(app, "--color", options.color,
                                  {{"auto", terminal::ColorUse::Auto},
                                   {"always", terminal::ColorUse::Always},
                                   {"never", terminal::ColorUse::Never}},
                                  "Colour on the screen (default: auto, unless NO_COLOR is set)");
    app.add_flag_callback(
        "--no-mouse", [&options] { options.mouse = false; },
        "Leave the mouse to the terminal, so that text can be selected");
    app.add_flag("--keep-going", options.keepGoing,
                 "Drop a record that cannot be read instead of ending with status 70");
    app.add_option("--log-level", options.logLevel,
                   "Write system-log lines up to this priority to standard error")
        ->check(CLI::Range(0, kHighestLevel).name("").description(""))
        ->type_name("0-7");
}

void addBrowse(CLI::App& app, BrowseOptions& options) {
    CLI::Option* recording =
        app.add_option(
               "RECORDING", options.recording,
               "A recording (pcap or pcapng; - is standard input) to browse as it is played; "
               "without one, the live modem")
            ->type_name("");
    addView(app, options);
    addPlay(app, options.play, recording);
}

void addDecode(CLI::App& app, DecodeOptions& options) {
    std::vector<std::pair<std::string, const RecordedTechnology*>> technologies;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        technologies.emplace_back(technology.commandName, &technology);
    }
    addChoice(app, "--technology", options.technology, technologies,
              "What the recordings are of (otherwise their link type tells)");
    addChoice<std::optional<Every>>(
        app, "--every", options.every,
        {{"end", Every::End}, {"tick", Every::Tick}, {"packet", Every::Packet}},
        "When the display is written (default: end; for csv, tick)");
    addChoice<DecodeFormat>(app, "--format", options.format,
                            {{"json", DecodeFormat::Json}, {"csv", DecodeFormat::Csv}},
                            "JSON, one object a line, or CSV (default: json)");
    app.add_option("--system-log", options.systemLog, "Write every system-log line to this file")
        ->type_name("FILE");
    app.add_flag("--strict", options.strict,
                 "End with status 70 at a record that cannot be read instead of skipping it");
    app.add_option("RECORDING", options.recordings, "Recordings (pcap or pcapng)")
        ->required()
        ->type_name("");
    app.footer(kDecodeFooter);
}

void addService(CLI::App& app, ServiceOptions& options) {
    CLI::Option* recording =
        app.add_option("--play", options.recording, "The recording to play to each viewer")
            ->type_name("RECORDING");
    CLI::Option* simulated = addServiceSimulation(app, options.simulation);
    simulated->excludes(recording);
    addPlay(app, options.play, recording);
    app.footer(kServiceFooter);
}

/// CLI11's messages may have several lines; the user gets one sentence.
ParseEnd wrongUsage(std::string reason) {
    std::replace(reason.begin(), reason.end(), '\n', ' ');
    return {kExitWrongUsage, "pallax: " + reason + " (pallax --help tells more)\n"};
}

ParseEnd parseEnd(const CLI::App& app, const CLI::ParseError& error) {
    if (dynamic_cast<const CLI::CallForVersion*>(&error) != nullptr) {
        return {kExitSuccess, std::string(kVersionText) + "\n"};
    }
    if (error.get_exit_code() == static_cast<int>(CLI::ExitCodes::Success)) {
        return {kExitSuccess, app.help()};
    }
    return wrongUsage(error.what());
}

bool loopsStandardInput(std::string_view recording, const PlayOptions& play) {
    return play.loop && recording == "-";
}

/// Help pages without the library's marks for what an option demands.
class PlainFormatter final : public CLI::Formatter {
public:
    std::string make_option_opts(const CLI::Option* option) const override {
        const std::string type = option->get_type_name();
        return type.empty() ? "" : " " + type;
    }
};

/// The help and version flags that every command has.
void prepare(CLI::App& app) {
    app.formatter(std::make_shared<PlainFormatter>());
    app.set_help_flag("-h,--help", "Show this help and exit");
    app.set_version_flag("--version", kVersionText, "Show the version and exit");
}

} // namespace

ParsedOptions parseOptions(std::vector<std::string> arguments) {
    CLI::App app("Pallax shows what a phone's cellular radio is doing.", "pallax");
    BrowseOptions browse;
    DecodeOptions decode;
    ServiceOptions service;
    prepare(app);
    addBrowse(app, browse);
    app.footer(kFooter);
    CLI::App* decodeApp = app.add_subcommand("decode", "Recordings to JSON or CSV");
    prepare(*decodeApp);
    addDecode(*decodeApp, decode);
    CLI::App* serviceApp =
        app.add_subcommand("service", "Run the telephony service that viewers connect to");
    prepare(*serviceApp);
    addService(*serviceApp, service);
    BrowseOptions demo;
    CLI::App* demoApp = app.add_subcommand("demo", "Browse a simulated modem");
    prepare(*demoApp);
    addDemo(*demoApp, demo.simulation.emplace(), demo.play);
    addView(*demoApp, demo);
    SimulateOptions simulate;
    CLI::App* simulateApp =
        app.add_subcommand("simulate", "Write a simulated modem's packets as a recording");
    prepare(*simulateApp);
    addSimulate(*simulateApp, simulate);

    const std::string first = arguments.empty() ? "" : arguments.front();
    std::reverse(arguments.begin(), arguments.end()); // as CLI11 takes them
    try {
        app.parse(arguments);
    } catch (const CLI::ParseError& error) {
        return parseEnd(app, error);
    }
    for (const CLI::App* command : app.get_subcommands()) {
        if (command->get_name() != first) {
            return wrongUsage("the command \"" + command->get_name() +
                              "\" must come first, without options before it");
        }
    }
    if (loopsStandardInput(browse.recording.value_or(""), browse.play) ||
        loopsStandardInput(service.recording, service.play)) {
        return wrongUsage("standard input can be played only once, not with --loop");
    }
    if (decodeApp->parsed()) {
        return decode;
    }
    if (serviceApp->parsed()) {
        if (service.recording.empty() && !service.simulation) {
            return wrongUsage("service: --play or --simulate is required");
        }
        return service;
    }
    if (demoApp->parsed()) {
        return demo;
    }
    if (simulateApp->parsed()) {
        return simulate;
    }
    return browse;
}

} // namespace pallax
