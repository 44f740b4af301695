#include "cli/OptionParts.h"
#include "cli/Options.h"

namespace pallax {

namespace {

constexpr const char* kDecodeFooter = R"(Examples:
  pallax decode drive.pcap
  pallax decode --every tick drive.pcap | jq .display
  pallax decode --every packet --format csv --technology lte raw.pcap
  pallax decode --system-log drive.log drive.pcap
  pallax decode --at 14:03:20 drive.pcap
  pallax decode --every tick --from +90s --to -5m drive.pcap
  pallax decode --format csv --select '*.measured_rsrp' drive.pcap
  pallax decode --every tick --where 'measured_rsrp < -100' drive.pcap
  pallax decode --samples --select '*.measured_rsrp' drive.pcap
  pallax decode --table 'Neighbor Cells List' --at 14:03 drive.pcap
  pallax decode --wide --select '*.measured_rsrp' drive.pcap > rsrp.csv
  pallax decode --join drive-0001.pcapng drive-0002.pcapng

Ticks are 2.0 s of recording time apart, counted from the first packet. "-" is
standard input; a recording may be a named pipe, and compressed with gzip or
zstd. Displays from a pipe are written without delay; several pipes are read in
parallel and written one after the other. On a terminal, runs of more than two
seconds show their progress, and characters that could command the terminal are
escaped (\x1B, \u202E); CSV in files and pipes is as the modem sent it.

A TIME is a local time (14:03 or 14:03:20.5, the first in the recording), a date
with or without a time and a zone (2023-11-14T14:03Z, "2023-11-14 14:03"), a
distance from the start (+90s, +1h30m) or before the end (-5m), or start or end.
The end of a pipe is not known. Packets before --from are decoded, but only
displays from then on are written. Reading ends at the first packet after --to
or --at.

A FIELD is a name that pallax fields lists; * stands for any letters. --typed
writes a number as {"number":-94.75,"unit":"dBm","text":"-94.75 dBm"}.

With --where, only the displays at which a condition holds are written: of the
ticks, the packets, or the end. It is an expression of SQL on a row of the table
"state" of pallax sql, with the columns and functions there: time, packet, tick
(NULL without --every tick), fields (measured_rsrp, or the full name) and their
ages in seconds (measured_rsrp_age). NULL does not hold. In CSV, the changes are
then those since the display that was written before.

With --samples a line has the time and number of the packet, the field, the
place of its list entry ("index", from 1) and what identifies it ("entry"), the
number in the record ("raw"), the value, which is a number if it has one, and
its unit; what is missing is null. Fields that no display shows are among them.

With --wide a column is called as its field, in a list with what identifies the
entry, which is the same wherever the entry stands:
lte.neighbor_cells_list.measured_rsrp[Physical Cell ID 275]. There is one for
each field that the recording has, so choose some with --select. A row has the
current values at a tick (--every packet: after each packet); numbers have no
units. The recording is read twice and cannot be a pipe.

A SECTION of --table is named as on the screen, or as in the names of its fields
(neighbor_cells_list); a list inside a section, with both names. The table is
for people, with each unit in the head.

With --join the recordings must have one technology. They are read in the order
of their first packets, and each continues the state of the one before.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: cannot read a recording or template, or write the output
  2   wrong usage, or a wrong condition
  70  with --strict: ended by a fatal record)";

void addChoices(CLI::App& app, DecodeOptions& options) {
    addTechnology(app, "--technology", options.technology,
                  "The technology of the recordings (default: from their link type)");
    addChoice<std::optional<Every>>(
        app, "--every", options.every,
        {{"end", Every::End}, {"tick", Every::Tick}, {"packet", Every::Packet}},
        "When to write the display (default: end; for csv, tick)");
    addChoice<std::optional<DecodeFormat>>(
        app, "--format", options.format, {{"json", DecodeFormat::Json}, {"csv", DecodeFormat::Csv}},
        "JSON, one object per line, or CSV (default: json)");
}

void addViews(CLI::App& app, DecodeOptions& options) {
    app.add_flag_callback(
           "--samples", [&options] { options.view = DecodeView::Samples; },
           "Write each value that is read from a packet, not displays")
        ->excludes("--every");
    app.add_flag_callback(
           "--wide", [&options] { options.view = DecodeView::Wide; },
           "CSV with a column for each field and a row for each tick")
        ->excludes("--samples");
    app.add_option_function<std::string>(
           "--table",
           [&options](const std::string& section) {
               options.view = DecodeView::Table;
               options.table = section;
           },
           "Write a section or list as a table, at the end or --at a time")
        ->type_name("SECTION")
        ->excludes("--samples")
        ->excludes("--wide")
        ->excludes("--every")
        ->excludes("--format");
}

void addTimes(CLI::App& app, DecodeOptions& options) {
    addTime(app, "--from", options.window.from, "Write no displays before this time");
    addTime(app, "--to", options.window.to, "Stop reading after this time");
    addTime(app, "--at", options.at, "Write the display at this time only")
        ->excludes("--every")
        ->excludes("--samples")
        ->excludes("--from")
        ->excludes("--to");
}

void addContent(CLI::App& app, DecodeOptions& options) {
    app.add_option_function<std::vector<std::string>>(
           "--select",
           [&options](const std::vector<std::string>& names) {
               options.select.insert(options.select.end(), names.begin(), names.end());
           },
           "Write only these fields (repeat it for several)")
        ->expected(1)
        ->take_all()
        ->allow_extra_args(false)
        ->type_name("FIELD");
    app.add_option("--where", options.where, "Write only the displays at which this holds")
        ->type_name("CONDITION");
    app.add_flag("--typed", options.typed, "JSON: numbers with their units, as objects");
    app.add_flag("--recording-column", options.recordingColumn,
                 "CSV: the name of the recording, as the first column");
}

} // namespace

void addDecode(CLI::App& app, DecodeOptions& options) {
    addChoices(app, options);
    addViews(app, options);
    addTimes(app, options);
    addContent(app, options);
    app.add_option("--system-log", options.systemLog, "Write every system-log line to this file")
        ->type_name("FILE");
    constexpr unsigned kMostJobs = 1024;
    app.add_option_function<std::string>(
           "--jobs",
           [&options](const std::string& text) {
               options.jobs = numberOf("--jobs", text, 1U, kMostJobs);
           },
           "How many recordings to decode at once (default: one per core)")
        ->type_name("N");
    app.add_flag("--join", options.join, "The recordings are one, in the order of their times");
    app.add_flag("--strict", options.strict,
                 "Exit with status 70 at a record that cannot be read instead of skipping it");
    app.add_option("RECORDING", options.recordings,
                   "Recordings (pcap or pcapng) and saved snapshots")
        ->required()
        ->type_name("");
    app.footer(kDecodeFooter);
}

std::string decodeRefusal(const DecodeOptions& options) {
    if (options.view == DecodeView::Wide && options.chosenFormat() != DecodeFormat::Csv) {
        return "--wide requires --format csv";
    }
    if (options.view == DecodeView::Wide && options.recordings.size() > 1 && !options.join) {
        return "--wide takes one recording, or several with --join";
    }
    if (options.typed && options.view != DecodeView::Displays) {
        return "--typed writes displays, not values, columns or a table";
    }
    if (options.recordingColumn && options.chosenFormat() != DecodeFormat::Csv) {
        return "--recording-column requires --format csv";
    }
    if (options.typed && options.chosenFormat() != DecodeFormat::Json) {
        return "--typed requires --format json";
    }
    if (options.where && options.view == DecodeView::Samples) {
        return "--where chooses displays, and --samples writes none";
    }
    return {};
}

} // namespace pallax
