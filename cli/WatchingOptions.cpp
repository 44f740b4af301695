#include "cli/InspectOptions.h"
#include "cli/OptionParts.h"
#include "watching/WatchCommand.h"

#include <CLI/CLI.hpp>

#include <utility>

namespace pallax {

namespace {

constexpr const char* kWatchFooter = R"(Examples:
  pallax watch 'measured_rsrp < -110' drive.pcap
  pallax watch --for 10s "quality('rsrp', measured_rsrp) = 'poor'" drive.pcap
  pallax watch --once 'measured_rsrp < -110'
  pallax watch --rule weak drive.pcap
  pallax watch --exec 'notify-send "RSRP $PALLAX_MEASURED_RSRP"' \
      'measured_rsrp < -110'

Looks at a condition at each display tick of recordings or, without one, of the
live modem, until Ctrl-C, the end of its source, or a change of its technology.
The condition is an expression of SQL on a row of the table "state" of pallax
sql: time, packet, tick, fields and their ages. It becomes true at the first
tick at which it holds or, with --for, at which it has held for so long.

With --rule, there is no CONDITION: the condition, and how long it must hold,
are those of an alarm of pallax.conf(5).

Each time it becomes true, a line has the local time, "holds" and the condition;
when it no longer holds, a line has "ended" and for how long it held. Recordings
follow one another, each with its name and without the state of the one before;
the numbered parts of one (drive-0001.pcapng, drive-0002.pcapng) are one. A
record that cannot be read is left out. A tick without packets is not looked at.

With --exec, /bin/sh runs a command each time the condition becomes true, with
an empty standard input and these environment variables:

  PALLAX_CONDITION  the condition
  PALLAX_TIME       when it became true (2023-11-14T22:13:20.000Z)
  PALLAX_PACKET     the number of the latest packet before that
  PALLAX_SOURCE     the name of the recording, or "live modem"

and one for each other column that the condition names: PALLAX_MEASURED_RSRP for
measured_rsrp, empty if it has no value. Write "$PALLAX_MEASURED_RSRP", with the
double quotes, because a value can be any text. A command that fails does not
end watching. On recordings, reading goes on when the command has ended. On the
live modem it goes on at once; if the condition becomes true again before the
command has ended, a sentence says that the command is not run for that time.

Exit status:
  0   the condition never became true
  1   it became true, or the reader of the output has gone
  2   wrong usage, or a wrong condition
  3   could not tell: a recording or the modem cannot be read; or failure)";

std::chrono::nanoseconds durationOf(const std::string& text) {
    const auto seconds = parseSecondsWithUnit(text);
    if (!seconds) {
        throw CLI::ValidationError("--for", seconds.error());
    }
    return *seconds;
}

/// With a rule, there is no condition: all arguments are recordings.
void addRule(CLI::App& app, WatchOptions& options, CLI::Option& condition) {
    app.add_option_function<std::string>(
           "--rule",
           [&options, &condition](const std::string& name) {
               options.rule = name;
               condition.required(false);
           },
           "Look at this alarm of pallax.conf instead of CONDITION")
        ->type_name("NAME")
        ->excludes("--for");
    app.callback([&options] {
        if (options.rule && !options.condition.empty()) {
            options.recordings.insert(options.recordings.begin(),
                                      std::exchange(options.condition, {}));
        }
    });
}

} // namespace

void addWatch(CLI::App& app, WatchOptions& options) {
    addTechnology(app, "--technology", options.technology,
                  "The technology of the recordings (default: from their link type)");
    app.add_option_function<std::string>(
           "--for", [&options](const std::string& text) { options.needed = durationOf(text); },
           "How long the condition must hold to be true (10 or 10s)")
        ->type_name("SECONDS");
    app.add_option("--exec", options.command, "Run this command each time it becomes true")
        ->type_name("COMMAND");
    app.add_flag("--once", options.once, "End when it has become true");
    CLI::Option* condition = app.add_option("CONDITION", options.condition, "The condition");
    condition->required()->type_name("");
    addRule(app, options, *condition);
    CLI::Option* connect = addConnect(app, options.service);
    app.add_option("RECORDING", options.recordings,
                   "Recordings (pcap or pcapng; - is standard input; default: the live modem)")
        ->excludes(connect)
        ->type_name("");
    app.footer(kWatchFooter);
}

} // namespace pallax
