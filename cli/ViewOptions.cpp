#include "cli/InspectOptions.h"
#include "cli/OptionParts.h"
#include "inspecting/StatusCommand.h"

#include <CLI/CLI.hpp>

namespace pallax {

namespace {

constexpr const char* kStatusFooter = R"(Examples:
  pallax status drive.pcap
  pallax status --at 14:03:20 drive.pcap
  pallax status --json drive.pcap | jq -r '.cells[].levels[] | .name, .text'

Shows the radio in at most ten lines of 80 columns: the technology and the time,
the operator with the source of its name, the serving cell of each system, its
channel, band and frequency, the levels, the states of the protocols, the three
strongest neighbours, and the packet data contexts. What the recording does not
tell has no line. A line with a value that was read more than 10 s ago says so.

A level is called excellent, good, fair, poor or none by a profile (see pallax
explain --help), because no standard does; the line names the profile.

A TIME is as in pallax decode --help. Of a saved snapshot, the latest display is
shown that is not later. JSON has all neighbours, the field of each value, and
the time at which it was read.

Exit status:
  0   success, or the reader of the output has gone
  1   the recording tells nothing about the radio; or failure, as one sentence
  2   wrong usage
  3   could not tell: the recording cannot be read, or lacks that time)";

} // namespace

void addStatus(CLI::App& app, StatusOptions& options) {
    addTechnology(app, "--technology", options.technology,
                  "The technology of the recording (default: from its link type)");
    addTime(app, "--at", options.at, "Show the radio at this time (default: at the end)");
    app.add_option("--profile", options.profile,
                   "The profile that judges levels (default: android)")
        ->type_name("android|field|operator|NAME");
    app.add_flag("--json", options.json, "JSON, one object");
    app.add_option("RECORDING", options.recording,
                   "The recording (pcap or pcapng; - is standard input) or saved snapshot")
        ->required()
        ->type_name("");
    app.footer(kStatusFooter);
}

} // namespace pallax
