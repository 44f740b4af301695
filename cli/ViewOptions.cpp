#include "cli/InspectOptions.h"
#include "cli/OptionParts.h"
#include "inspecting/DiffCommand.h"
#include "inspecting/StatusCommand.h"

#include <CLI/CLI.hpp>

namespace pallax {

namespace {

constexpr const char* kStatusFooter = R"(Examples:
  pallax status
  pallax status drive.pcap
  pallax status --at 14:03:20 drive.pcap
  pallax status --json drive.pcap | jq -r '.cells[].levels[] | .name, .text'

Shows the radio in at most ten lines of 80 columns: the technology and the time,
the operator with the source of its name, the serving cell of each system, its
channel, band and frequency, the levels, the states of the protocols, the three
strongest neighbours, and the packet data contexts. What the recording does not
tell has no line. A line with a value that was read more than 10 s ago says so.

Without a recording, it first receives the live modem for five seconds (--for),
or until Ctrl-C or the end of its source.

A level is called excellent, good, fair, poor or none by a profile (see pallax
explain --help), because no standard does; the line names the profile.

A TIME is as in pallax decode --help. Of a saved snapshot, the latest display is
shown that is not later. JSON has all neighbours, the field of each value, and
the time at which it was read.

Exit status:
  0   success, or the reader of the output has gone
  1   the recording tells nothing about the radio; or failure, as one sentence
  2   wrong usage
  3   could not tell: recording or modem cannot be read, or lacks that time)";

constexpr const char* kDiffFooter = R"(Examples:
  pallax diff drive.pcap@14:02:50 drive.pcap@14:03:10
  pallax diff --select 'lte.*rsrp' monday.pcap tuesday.pcap
  pallax diff PallaxSnapshot-1700000000.pallax drive.pcap@end
  pallax diff --json drive.pcap@start drive.pcap@+90s | jq -r .field

Compares the radio at two moments. BEFORE and AFTER are recordings or saved
snapshots, FILE or FILE@TIME, with a TIME as in pallax decode --help; without
one, the end is meant. A file whose name contains "@" is found first. "-" is
standard input; with times, write "pallax diff -- -@14:02 -@14:03".

Entries of lists are compared by what identifies them, such as the identity of a
cell, not by their place: one is "gone", "new", or has other values. For values
with a unit the difference follows; that of two levels in dBm is in dB.

Left out are fields that are not shown, and those that count or follow time,
which always differ: sub-frame and offset numbers, and the counters of blocks.
With --all they are compared too, and those that --select names. A FIELD is a
name that pallax fields lists; * stands for any letters.

JSON has a line for each value, with its field, its entry, and its change:
changed, gone or new. Where nothing differs, nothing is written.

Exit status:
  0   nothing differs
  1   something differs, or the reader of the output has gone
  2   wrong usage
  3   could not tell: a file is damaged or lacks that time; or failure)";

} // namespace

void addStatus(CLI::App& app, StatusOptions& options) {
    addTechnology(app, "--technology", options.technology,
                  "The technology of the recording (default: from its link type)");
    CLI::Option* at =
        addTime(app, "--at", options.at, "Show the radio at this time (default: at the end)");
    app.add_option("--profile", options.profile,
                   "The profile that judges levels (default: android)")
        ->type_name("android|field|operator|NAME");
    app.add_flag("--json", options.json, "JSON, one object");
    CLI::Option* recording =
        app.add_option("RECORDING", options.recording,
                       "The recording (pcap or pcapng; - is standard input) or saved snapshot "
                       "(default: the live modem)")
            ->type_name("");
    at->needs(recording);
    addDuration(app, options.duration, "Receive the live modem for so long (default: 5)")
        ->excludes(recording);
    addConnect(app, options.service)->excludes(recording);
    app.footer(kStatusFooter);
}

void addDiff(CLI::App& app, DiffOptions& options) {
    addTechnology(app, "--technology", options.technology,
                  "The technology of the recordings (default: from their link type)");
    app.add_option_function<std::vector<std::string>>(
           "--select",
           [&options](const std::vector<std::string>& names) {
               options.select.insert(options.select.end(), names.begin(), names.end());
           },
           "Compare only these fields (repeat it for several)")
        ->expected(1)
        ->take_all()
        ->type_name("FIELD");
    app.add_flag("--all", options.all, "Compare hidden fields and counters, too");
    app.add_flag("--json", options.json, "JSON, one object per line");
    app.add_option("BEFORE", options.before, "A recording or saved snapshot, or FILE@TIME")
        ->required()
        ->type_name("");
    app.add_option("AFTER", options.after, "What to compare it with")->required()->type_name("");
    app.footer(kDiffFooter);
}

} // namespace pallax
