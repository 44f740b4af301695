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
  pallax record drive.pcapng           write what the live modem sends to a file
  pallax service --play drive.pcap     let viewers connect to a played recording

A recording that is named like a command is given with its folder: pallax ./decode

Exit status: 0 success, 1 failure, 2 wrong usage, 70 ended by a fatal record.)";

constexpr const char* kDecodeFooter = R"(Examples:
  pallax decode drive.pcap
  pallax decode --every tick drive.pcap | jq .display
  pallax decode --every packet --format csv --technology lte raw.pcap
  pallax decode --system-log drive.log drive.pcap

Ticks are 2.0 s of recording time apart, counted from the first packet. "-" is standard input.)";

constexpr const char* kRecordFooter = R"(Examples:
  pallax record drive.pcapng
  pallax record --technology lte --rotate-size 100M drive.pcapng
  pallax record - | ssh desk pallax service --relay -

With --rotate-size or --rotate-seconds the files are drive-0001.pcapng, drive-0002.pcapng, ...
Recording ends with Ctrl-C, and with the source. A viewer may run at the same time.)";

constexpr const char* kServiceFooter = R"(Examples:
  pallax service --play drive.pcap
  pallax service --play drive.pcap --speed max --loop
  pallax service --simulate lte --seed 7
  pallax service --simulate ifx --seconds 600 --speed max
  ssh phone modem-dump | pallax service --relay -
  pallax service --status

Every client gets a channel of its own. A recording or simulation begins anew for each; what is
relayed goes to all as it comes, and the service ends with it. A client that is too slow loses packets and
delays nobody; with --speed max it sets its own pace and loses nothing.)";

void addPlay(CLI::App& app, PlayOptions& play, CLI::Option* recording) {
    addSpeed(app, play)->needs(recording);
    app.add_flag("--loop", play.loop, "Begin again at the recording's end")->needs(recording);
}

void addLogLevel(CLI::App& app, std::optional<int>& level) {
    constexpr int kHighestLevel = 7;
    app.add_option("--log-level", level,
                   "Write system-log lines up to this priority to standard error")
        ->check(CLI::Range(0, kHighestLevel).name("").description(""))
        ->type_name("0-7");
}

/// What is common to all ways of browsing.
void addView(CLI::App& app, BrowseOptions& options) {
    app.add_flag("--print", options.print,
                 "Print the tree as text at each display tick, as is done without a terminal");
    addChoice<terminal::ColorUse>(
        app, "--color", options.color,
        {{"auto", terminal::ColorUse::Auto},
         {"always", terminal::ColorUse::Always},
         {"never", terminal::ColorUse::Never}},
        "Colour on the screen (default: auto, which is never where NO_COLOR is set)");
    app.add_flag_callback(
        "--no-mouse", [&options] { options.mouse = false; },
        "Leave the mouse to the terminal, so that text can be selected");
    app.add_flag("--keep-going", options.keepGoing,
                 "Drop a record that cannot be read instead of ending with status 70");
    addLogLevel(app, options.logLevel);
}

void addTechnology(CLI::App& app, const RecordedTechnology*& technology,
                   const std::string& description) {
    std::vector<std::pair<std::string, const RecordedTechnology*>> technologies;
    for (const RecordedTechnology& each : recordedTechnologies()) {
        technologies.emplace_back(each.commandName, &each);
    }
    addChoice(app, "--technology", technology, technologies, description);
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
    addTechnology(app, options.technology,
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
    constexpr unsigned kMostJobs = 1024;
    app.add_option_function<std::string>(
           "--jobs",
           [&options](const std::string& text) {
               options.jobs = numberOf("--jobs", text, 1U, kMostJobs);
           },
           "How many recordings to decode at once (default: as many as there are cores)")
        ->type_name("N");
    app.add_flag("--strict", options.strict,
                 "End with status 70 at a record that cannot be read instead of skipping it");
    app.add_option("RECORDING", options.recordings, "Recordings (pcap or pcapng)")
        ->required()
        ->type_name("");
    app.footer(kDecodeFooter);
}

void addRecord(CLI::App& app, RecordOptions& options) {
    constexpr double kLongest = 1e9; // seconds, about 30 years
    app.add_option("FILE", options.files.path,
                   "The recording to write (pcapng; - is standard output)")
        ->required()
        ->type_name("");
    addTechnology(app, options.technology, "Refuse a modem that speaks another technology");
    const auto takeSize = [&options](const std::string& text) {
        options.files.rotateSize = parseSize(text);
        if (!options.files.rotateSize) {
            throw CLI::ValidationError("--rotate-size",
                                       "\"" + text + "\" is no size like 4096, 64k, 100M or 2G");
        }
    };
    app.add_option_function<std::string>("--rotate-size", takeSize,
                                         "Begin the next file before one has more bytes than that")
        ->type_name("BYTES[k|M|G]");
    const auto takeSeconds = [&options](const double& seconds) {
        if (!(seconds > 0 && seconds <= kLongest)) {
            throw CLI::ValidationError("--rotate-seconds", "it takes a number above 0");
        }
        options.files.rotateAfter = std::chrono::duration_cast<std::chrono::nanoseconds>(
            std::chrono::duration<double>(seconds));
    };
    app.add_option_function<double>("--rotate-seconds", takeSeconds,
                                    "Begin the next file after so many seconds")
        ->type_name("SECONDS");
    app.add_flag_callback(
        "--overwrite", [&options] { options.files.existing = PcapNgWriter::Existing::Overwrite; },
        "Replace files that exist already");
    addLogLevel(app, options.logLevel);
    app.footer(kRecordFooter);
}

/// CLI11's messages may have several lines; the user gets one sentence.
ParseEnd wrongUsage(std::string reason) {
    std::replace(reason.begin(), reason.end(), '\n', ' ');
    return {kExitWrongUsage, "pallax: " + reason + " (pallax --help tells more)\n"};
}

/// What the service is to do, one of them.
struct ServiceRequest {
    ServiceOptions options;
    std::string relayed; ///< a stream; empty where none is asked for
    bool status = false;
};

void addServicePlay(CLI::App& app, ServiceOptions& options) {
    CLI::Option* recording =
        app.add_option("--play", options.recording, "The recording to play to each client")
            ->type_name("RECORDING");
    addSpeed(app, options.play);
    app.add_flag("--loop", options.play.loop, "Begin again at the recording's end")
        ->needs(recording);
}

void addServiceSimulated(CLI::App& app, std::optional<SimulationOptions>& simulation) {
    addServiceSimulation(app, simulation)->excludes("--play");
}

void addServiceRelay(CLI::App& app, std::string& relayed) {
    const auto take = [&relayed](const std::string& text) {
        if (text != "-") {
            throw CLI::ValidationError("--relay", "only -, standard input, can be relayed");
        }
        relayed = text;
    };
    app.add_option_function<std::string>(
           "--relay", take, "Pass on the live pcap stream of standard input (-) to every client")
        ->type_name("-")
        ->excludes("--play")
        ->excludes("--speed") // the stream has its own
        ->excludes("--simulate");
}

void addServiceStatus(CLI::App& app, bool& status) {
    app.add_flag("--status", status, "Print what the running service serves, and end")
        ->excludes("--play")
        ->excludes("--speed")
        ->excludes("--simulate")
        ->excludes("--relay");
}

void addService(CLI::App& app, ServiceRequest& request) {
    addServicePlay(app, request.options);
    addServiceSimulated(app, request.options.simulation);
    addServiceRelay(app, request.relayed);
    addServiceStatus(app, request.status);
    app.footer(kServiceFooter);
}

ParsedOptions serviceOptions(const ServiceRequest& request) {
    if (request.status) {
        return ServiceStatusOptions();
    }
    ServiceOptions options = request.options;
    if (!request.relayed.empty()) {
        options.recording = request.relayed;
        options.relay = true;
    }
    if (options.recording.empty() && !options.simulation) {
        return wrongUsage("the service needs --play, --simulate, --relay or --status");
    }
    return options;
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
    RecordOptions record;
    ServiceRequest service;
    prepare(app);
    addBrowse(app, browse);
    app.footer(kFooter);
    CLI::App* decodeApp = app.add_subcommand("decode", "Recordings to JSON or CSV");
    prepare(*decodeApp);
    addDecode(*decodeApp, decode);
    CLI::App* recordApp = app.add_subcommand("record", "Write the live channel to a recording");
    prepare(*recordApp);
    addRecord(*recordApp, record);
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
        loopsStandardInput(service.options.recording, service.options.play)) {
        return wrongUsage("standard input can be played only once, not with --loop");
    }
    if (record.files.path == "-" && record.files.rotates()) {
        return wrongUsage("standard output is one recording, without --rotate-size and "
                          "--rotate-seconds");
    }
    if (recordApp->parsed()) {
        return record;
    }
    if (decodeApp->parsed()) {
        return decode;
    }
    if (serviceApp->parsed()) {
        return serviceOptions(service);
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
