#include "cli/Options.h"

#include "cli/Amounts.h"
#include "cli/CommandLine.h"
#include "cli/OptionParts.h"
#include "cli/SimulateOptions.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kFooter = R"(Examples:
  pallax                               browse the live modem
  pallax drive.pcap --speed 4          browse a recording, four times as fast
  modem-dump | pallax -                browse what another program records
  pallax demo                          browse a simulated modem
  pallax decode drive.pcap             its last display as JSON
  pallax decode --every tick --format csv drive.pcap > drive.csv
  pallax record drive.pcapng           write what the live modem sends to a file
  pallax service --play drive.pcap     let viewers connect to a played recording

Each command has a help of its own (pallax decode --help). A recording named
like a command is given with its folder (pallax ./decode).

Exit status:
  0   success, also when nobody reads the output any more
  1   failure: one sentence on standard error tells which
  2   wrong usage
  70  ended by a fatal record (--keep-going drops it instead))";

constexpr const char* kDecodeFooter = R"(Examples:
  pallax decode drive.pcap
  pallax decode --every tick drive.pcap | jq .display
  pallax decode --every packet --format csv --technology lte raw.pcap
  pallax decode --system-log drive.log drive.pcap

Ticks are 2.0 s of recording time apart, counted from the first packet. "-" is
standard input; a recording may be a named pipe. What comes through a pipe is
written as it comes; several pipes are read at once and written one after the
other. On a terminal, what takes more than two seconds shows how far it has
come, and characters that could command the terminal stand as escapes (\x1B,
\u202E); files and pipes get CSV as the modem sent it.

Exit status:
  0   success, also when nobody reads the output any more
  1   failure: a recording or template cannot be read, or the output be written
  2   wrong usage
  70  with --strict: ended by a fatal record)";

constexpr const char* kRecordFooter = R"(Examples:
  pallax record drive.pcapng
  pallax record --technology lte --rotate-size 100M drive.pcapng
  pallax record - | ssh desk pallax service --relay -

With --rotate-size or --rotate-seconds the files are drive-0001.pcapng,
drive-0002.pcapng, ... up to 9999. Recording ends with Ctrl-C, and with the
source. A viewer may run at the same time. Where no service runs, it says so and
waits for one.

A file holds one technology. When the modem comes back with another one, the
recording goes on in drive-2.pcapng, or in the next number. With --overwrite an
earlier file stays as it is until the first packet comes. A file that is removed
or changed by others while it is being written ends the recording.

Exit status:
  0   success: ended by Ctrl-C, by the source, or by the reader of the output
  1   failure: the recording cannot be written, or holds another technology
  2   wrong usage)";

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

} // namespace

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

namespace {

void addTechnology(CLI::App& app, const RecordedTechnology*& technology,
                   const std::string& description) {
    std::vector<std::pair<std::string, const RecordedTechnology*>> technologies;
    for (const RecordedTechnology& each : recordedTechnologies()) {
        technologies.emplace_back(each.commandName, &each);
    }
    addChoice(app, "--technology", technology, technologies, description);
}

} // namespace

void addBrowse(CLI::App& app, BrowseOptions& options) {
    CLI::Option* recording =
        app.add_option(
               "RECORDING", options.recording,
               "A recording (pcap or pcapng, a file or a named pipe; - is standard input) to "
               "browse as it is played; without one, the live modem")
            ->type_name("");
    addView(app, options);
    addPlay(app, options.play, recording);
    app.footer(kFooter);
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
    app.add_option("FILE", options.files.path,
                   "The recording to write (pcapng; - is standard output)")
        ->required()
        ->type_name("");
    addTechnology(app, options.technology, "Refuse a modem that speaks another technology");
    const auto takeSize = [&options](const std::string& text) {
        const auto size = parseSize(text);
        if (!size) {
            throw CLI::ValidationError("--rotate-size", size.error());
        }
        options.files.rotateSize = *size;
    };
    app.add_option_function<std::string>("--rotate-size", takeSize,
                                         "Begin the next file before one has more bytes than that")
        ->type_name("BYTES[k|M|G]");
    const auto takeSeconds = [&options](const std::string& text) {
        const auto seconds = parseSeconds(text);
        if (!seconds) {
            throw CLI::ValidationError("--rotate-seconds", seconds.error());
        }
        options.files.rotateAfter = *seconds;
    };
    app.add_option_function<std::string>("--rotate-seconds", takeSeconds,
                                         "Begin the next file after so many seconds")
        ->type_name("SECONDS");
    app.add_flag_callback(
        "--overwrite", [&options] { options.files.existing = PcapNgWriter::Existing::Overwrite; },
        "Replace files that exist already");
    addLogLevel(app, options.logLevel);
    app.footer(kRecordFooter);
}

/// CLI11's messages may have several lines; the user gets one sentence.
ParseEnd wrongUsage(std::string reason, const std::string& command) {
    std::replace(reason.begin(), reason.end(), '\n', ' ');
    const std::string page = command.empty() ? "pallax" : "pallax " + command;
    return {kExitWrongUsage, "pallax: " + reason + " (" + page + " --help tells more)\n"};
}

ParsedOptions parseOptions(std::vector<std::string> arguments) {
    return CommandLine().parse(std::move(arguments));
}

} // namespace pallax
