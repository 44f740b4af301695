#include "cli/Options.h"

#include "cli/Amounts.h"
#include "cli/CommandLine.h"
#include "cli/ModemOptions.h"
#include "cli/OptionParts.h"
#include "cli/SimulateOptions.h"
#include "text/Format.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kFooter = R"(Examples:
  pallax                               browse the live modem
  pallax drive.pcap --speed 4          browse a recording, four times as fast
  modem-dump | pallax -                browse what another program records
  pallax --connect car1 --connect car2     browse two live modems side by side
  pallax demo                          browse a simulated modem
  pallax modem                         browse a modem of this machine
  pallax decode drive.pcap             print its last display as JSON
  pallax decode --every tick --format csv drive.pcap > drive.csv
  pallax record drive.pcapng           record the live modem
  pallax service --play drive.pcap     play a recording to viewers
  pallax events drive.pcap             list cell changes and other events
  pallax fields | grep -i rsrp         look up a field
  pallax explain earfcn 1850           what a number, a code or a field means
  pallax info drive.pcap               what a recording holds
  pallax status drive.pcap             the radio at its end, in a few lines
  pallax diff drive.pcap@14:02 drive.pcap@14:03     what has changed
  pallax sql drive.pcap 'select ...'   any question
  pallax watch 'measured_rsrp < -110'  tell when a condition becomes true
  pallax web --open                    see the live modem in the web browser

The numbered parts of a recording (drive-0001.pcapng drive-0002.pcapng) are
browsed as one, in the order of their times.

Several modems (--connect) are side by side where each has 79 columns, otherwise
one at a time; the keys 1 to 9 and Ctrl-N move the keyboard to another one. Each
needs a service with a name (pallax service --help).

Each command has its own help (pallax decode --help). To open a recording with
the name of a command, add its folder (pallax ./decode).

Exit status:
  0   success, or the reader of the output has gone
  1   failure, explained in one sentence on standard error
  2   wrong usage
  70  ended by a fatal record (--keep-going drops it instead))";

constexpr const char* kEventsFooter = R"(Examples:
  pallax events drive.pcap
  pallax events --json drive.pcap | jq -r 'select(.kind == "ping-pong").time'
  pallax events --where "kind = 'gap' or measured_rsrp < -110" drive.pcap
  modem-dump | pallax events -
  pallax events --live

A line has the local time, the kind and the words of an event: cell-change,
ping-pong (back in the cell before within 10 s), state-change,
technology-change, service-lost, service-regained, context-up, context-down,
gap (no packets for a minute), time-step (the clock was set back) or
fatal-record. In JSON, the time is UTC, "packet" is the packet that shows the
event, and "fields" names its fields. What a modem does not tell has no events.

With --where, only the events for which a condition holds are listed. It is an
expression of SQL on "kind", "words" and a row of the table "state" of pallax
sql as it is after the event's packet: time, packet, fields and their ages.

Recordings follow one another, each with its name. The numbered parts of one
(drive-0001.pcapng, drive-0002.pcapng, as pallax record writes them) are read as
one, in the order of their times; a part that is not given is left out, and the
first begins without a state.

A record that cannot be read ends the events of its recording. Events from a
pipe are written when they happen, and so are those of the live modem (--live),
until Ctrl-C, the end of its source, or a change of its technology.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: cannot read a recording or template, or write the output
  2   wrong usage, or a wrong condition
  70  ended by a fatal record)";

constexpr const char* kFieldsFooter = R"(Examples:
  pallax fields lte
  pallax fields | grep -i rsrp
  pallax fields --json | jq -r 'select(.personal).name'

A line has the field's name, unit, kind, range and marks ("-" if there is none),
then its meaning, its path in the display, and its labels separated by "|". In a
path, "*" is any entry of a list. A number can have a unit and a range, a label
is one of a few texts, and an object is a value of any type.

The mark "identity" is on the fields that together tell which cell, pilot or
context a list entry is, "personal" on those that identify a person, a device or
a subscription, and "hidden" on those that are read but not shown. In JSON,
"identity" names the identity fields of the field's list; "*" there is the
entry's name in the path.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: cannot read a template, or write the output
  2   wrong usage)";

constexpr const char* kExplainFooter = R"(Examples:
  pallax explain earfcn 1850
  pallax explain 262-01
  pallax explain lte.serving_cell_measurements.srxlev
  pallax explain rsrp -97 --profile field
  pallax explain --json band lte 3

WORDS are one of:

Channel numbers: arfcn N (GSM), uarfcn N (UMTS and UTRA TDD), earfcn N (LTE),
nrarfcn N (NR), cdma BANDCLASS CHANNEL; the other way, mhz SYSTEM MHZ and
band SYSTEM BAND, where SYSTEM is gsm, umts, utran, lte, nr or cdma.

Networks: 262-01, 262 01 or 26201, and mcc 262. An MNC of two digits and one of
three are different networks. The names come from the Debian packages
mobile-broadband-provider-info and iso-codes.

Cells: cell IDENTITY (LTE or UMTS), bsic N, ta STEPS (GSM and LTE), prb BLOCKS.

Fields: the name of a field or its end (srxlev), as pallax fields lists it, and
optionally a value.

Levels: rsrp, rsrq, sinr, rssi, rscp, ecno, rxlev, rxqual, cdma-rssi, evdo-rssi
or ecio, and a value. A profile says how good it is, because no standard does:
android (signal bars of phones), field (usual in drive tests), operator
(stricter), or NAME for your own in ~/.config/pallax/profiles/NAME.conf, whose
lines are like "rsrp = excellent -80, good -90, fair -100, poor -120". The
words profile NAME show a profile's borders and their source.

Words with several meanings have several answers, the likeliest first; in JSON,
each answer is a line.

Exit status:
  0   success, or the reader of the output has gone
  1   nothing is known about the words, or failure, as one sentence
  2   wrong usage)";

constexpr const char* kRecordFooter = R"(Examples:
  pallax record drive.pcapng
  pallax record --technology lte --rotate-size 100M drive.pcapng
  pallax record --modem drive.pcapng
  pallax record - | ssh desk pallax service --relay -

With --rotate-size or --rotate-seconds the files are drive-0001.pcapng,
drive-0002.pcapng, ... up to 9999. Recording stops on Ctrl-C or at the end of
the source. A viewer can run at the same time. If no service is running, record
says so and waits for one. With --modem it needs none, and records a modem of
this machine through ModemManager (see pallax modem --help).

A file holds one technology. If the modem returns with another one, recording
continues in drive-2.pcapng, or the next free number. With --overwrite, existing
files are kept until the first packet arrives. Recording stops if another
program removes or changes the file.

Exit status:
  0   success: ended by Ctrl-C, by the source, or by the reader of the output
  1   failure: the recording cannot be written, or holds another technology
  2   wrong usage)";

void addPlay(CLI::App& app, PlayOptions& play, CLI::Option* recording) {
    addSpeed(app, play)->needs(recording);
    app.add_flag("--loop", play.loop, "Restart at the end of the recording")->needs(recording);
}

void addConnections(CLI::App& app, BrowseOptions& options, CLI::Option& recording) {
    const auto take = [&options](const std::vector<std::string>& names) {
        std::vector<ServiceModem> modems;
        for (const std::string& name : names) {
            const bool isKnown = std::any_of(modems.begin(), modems.end(),
                                             [&](const auto& modem) { return modem.name == name; });
            if (isKnown) {
                throw CLI::ValidationError("--connect", "\"" + name + "\" is given twice");
            }
            modems.push_back({serviceNameOf("--connect", name)});
        }
        if (modems.size() > BrowseOptions::kMostModems) {
            throw CLI::ValidationError("--connect", "at most nine modems can be shown");
        }
        options.source = modems.front();
        options.further.assign(modems.begin() + 1, modems.end());
    };
    app.add_option_function<std::vector<std::string>>(
           "--connect", take,
           "The live modem of the service that has this name (repeat it for several modems, on one "
           "screen)")
        ->expected(1)
        ->take_all()
        ->allow_extra_args(false)
        ->excludes(&recording)
        ->type_name("NAME");
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
                 "Print the tree as text at each display tick (the default without a terminal)");
    app.add_flag("--plain", options.plain,
                 "Print what changes as sentences, for a screen reader, without a screen")
        ->excludes("--print");
    addChoice<terminal::ColorUse>(app, "--color", options.color,
                                  {{"auto", terminal::ColorUse::Auto},
                                   {"always", terminal::ColorUse::Always},
                                   {"never", terminal::ColorUse::Never}},
                                  "Colour on the screen (default: auto; never if NO_COLOR is set)");
    app.add_flag_callback(
        "--no-mouse", [&options] { options.mouse = false; },
        "Leave the mouse to the terminal, to select text");
    app.add_option("--profile", options.profile,
                   "The profile that judges levels (default: android, or that of pallax.conf)")
        ->type_name("android|field|operator|NAME");
    app.add_flag("--safe", options.safe,
                 "Show zeros in place of what identifies a person, whatever key is pressed");
    app.add_flag("--keep-going", options.keepGoing,
                 "Drop a record that cannot be read instead of exiting with status 70");
    addLogLevel(app, options.logLevel);
}

void addBrowse(CLI::App& app, BrowseOptions& options) {
    CLI::Option* recording =
        app.add_option_function<std::vector<std::string>>(
               "RECORDING",
               [&options](const std::vector<std::string>& paths) {
                   options.source = recordingToBrowse(paths);
               },
               "The recording or saved snapshot to browse (pcap or pcapng, a file or a named "
               "pipe; - is standard input; default: the live modem), or the numbered parts of one")
            ->type_name("");
    addConnections(app, options, *recording);
    addView(app, options);
    addPlay(app, options.play, recording);
    app.footer(kFooter);
}

void addEvents(CLI::App& app, EventsOptions& options) {
    addTechnology(app, "--technology", options.technology,
                  "The technology of the recordings (default: from their link type)");
    app.add_flag("--json", options.json, "JSON, one object per line");
    app.add_option("--where", options.where, "List only the events for which this holds")
        ->type_name("CONDITION");
    CLI::Option* live = addLive(app, options.live, options.duration, options.service);
    app.add_option("RECORDING", options.recordings, "Recordings (pcap or pcapng)")
        ->excludes(live)
        ->type_name("");
    app.footer(kEventsFooter);
}

void addFields(CLI::App& app, FieldsOptions& options) {
    app.add_flag("--json", options.json, "JSON, one object per line");
    addTechnology(app, "TECHNOLOGY", options.technology, "Technology of the fields (default: all)");
    app.footer(kFieldsFooter);
}

void addExplain(CLI::App& app, ExplainOptions& options) {
    app.add_flag("--json", options.json, "JSON, one object per line");
    app.add_option("--profile", options.profile,
                   "The profile that judges levels (default: android)")
        ->type_name("android|field|operator|NAME");
    app.add_option("WORDS", options.words, "What to explain")->required()->type_name("");
    app.footer(kExplainFooter);
}

void addRecord(CLI::App& app, RecordOptions& options) {
    app.add_option("FILE", options.files.path,
                   "The recording to write (pcapng; - is standard output)")
        ->required()
        ->type_name("");
    addTechnology(app, "--technology", options.technology,
                  "Refuse a modem that speaks another technology");
    addModemSource(
        app,
        [&options]() -> LocalModem& {
            return options.modem ? *options.modem : options.modem.emplace();
        },
        "Record a modem of this machine, by default the first one that is enabled");
    const auto takeSize = [&options](const std::string& text) {
        const auto size = parseSize(text);
        if (!size) {
            throw CLI::ValidationError("--rotate-size", size.error());
        }
        options.files.rotateSize = *size;
    };
    app.add_option_function<std::string>("--rotate-size", takeSize,
                                         "Start the next file before one exceeds this size")
        ->type_name("BYTES[k|M|G]");
    const auto takeSeconds = [&options](const std::string& text) {
        const auto seconds = parseSeconds(text);
        if (!seconds) {
            throw CLI::ValidationError("--rotate-seconds", seconds.error());
        }
        options.files.rotateAfter = *seconds;
    };
    app.add_option_function<std::string>("--rotate-seconds", takeSeconds,
                                         "Start the next file after this many seconds")
        ->type_name("SECONDS");
    app.add_flag_callback(
        "--overwrite", [&options] { options.files.existing = PcapNgWriter::Existing::Overwrite; },
        "Replace existing files");
    addConnect(app, options.service);
    addLogLevel(app, options.logLevel);
    app.footer(kRecordFooter);
}

/// CLI11's messages may have several lines; the user gets one sentence.
ParseEnd wrongUsage(std::string reason, const std::string& command) {
    std::replace(reason.begin(), reason.end(), '\n', ' ');
    const std::string page = command.empty() ? "pallax" : "pallax " + command;
    return {kExitWrongUsage, "pallax: " + reason + " (see " + page + " --help)\n"};
}

ParsedOptions parseOptions(std::vector<std::string> arguments) {
    return CommandLine().parse(std::move(arguments));
}

} // namespace pallax
