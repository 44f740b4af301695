#include "cli/InspectOptions.h"

#include "cli/Amounts.h"
#include "cli/OptionParts.h"
#include "decoding/InfoCommand.h"
#include "decoding/SnapshotCommand.h"
#include "querying/SqlCommand.h"

#include <CLI/CLI.hpp>

namespace pallax {

namespace {

constexpr const char* kInfoFooter = R"(Examples:
  pallax info drive.pcap
  pallax info --json monday/*.pcap.gz | jq -r 'select(.damaged > 0).file'

A file is read to its end without decoding it. "duration" is the time that its
stamps cover; "gaps" are times of more than 60 s without a packet, and at a
"step back" a stamp is more than 2 s before the latest one. The first eight of
each are listed. A "bad stamp" is not between 1970 and 2255. Packets with an
"unknown" log code are those that no section reads.

A record is counted as "damaged" if it is shorter than its header of 13 bytes,
if its log type is neither 1 nor 255, or if its length is refused by every
section that reads its log code; a message of an object stream, if it is empty.
Contents are not checked.

For a saved snapshot, the displays and the size of the DLF log are listed.
Displays that share a section all show it as it was when the snapshot was saved.

"fills" names the sections that the recording has data for. The numbered parts
of a recording (drive-0001.pcapng, drive-0002.pcapng) are described as one.
A file that is cut or damaged is described as far as it can be read.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: cannot read a file or template, or write the output
  2   wrong usage)";

constexpr const char* kSqlFooter = R"(Examples:
  pallax sql drive.pcap 'select time_text(time), words from event'
  pallax sql drive.pcap 'select physical_cell_id, avg(measured_rsrp)
      from serving_cell_measurements group by 1'
  pallax sql drive.pcap --format csv --file worst-cells.sql > worst.csv
  pallax sql drive.pcap
  pallax sql --live --for 60 'select time_text(time), words from event'

Without a query, those that you type are answered, or those on standard input;
each ends with ";". On a terminal, Tab completes names, Ctrl-C stops a query or
clears the line, .help lists the commands, and Ctrl-D ends. Earlier queries are
kept in $XDG_STATE_HOME/pallax/sql-history (by default ~/.local/state).

The query is one statement of SQL, as SQLite has it, that only reads. "time" is
UTC in microseconds. The tables:

  packet   a row for each packet
  sample   each value that was read
  span     each time that a field held a value
  state    each display tick: a column for each field that is in no list
  event    what happened
  cell     each cell in each of its roles
  series   the course of a field: series(field, buckets)
  field    the fields, as in "pallax fields"

and a table for each section and each list in it, with a row for each reading
(of a list, each entry): the name of a field
(lte.serving_cell_measurements.measured_rsrp) is technology, table and column.
There are functions for bands, frequencies, operators, qualities, labels and
quantiles. The manual page pallax-sql(7) describes all of them and has recipes:
"how did RSRP go", "what changed when the connection was lost", and more.

With --live, the query is about the packets of the live modem from now until
Ctrl-C, the end of its source, or --for. They are kept, and so are recordings
that cannot be read from the middle (from a pipe, compressed, or several):
256 MiB and, live, 24 hours at most (pallax.conf(5), journal-mebibytes).

Several recordings are one, in the order of their times, and each continues the
state of the one before. A column of numbers is NULL where the display has a
text instead ("Not Present").

Exit status:
  0   success, or the reader of the output has gone
  1   failure: cannot read a recording or write the output, or a query failed
  2   wrong usage, or a wrong query)";

constexpr const char* kSnapshotFooter = R"(Examples:
  pallax snapshot --dlf PallaxSnapshot-1700000000.pallax -o drive.dlf

To browse the displays of a snapshot, open it (pallax FILE); pallax decode
writes them as JSON or CSV, and pallax info tells what a snapshot holds. An
existing output file is replaced.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: not a snapshot, no DLF log in it, or cannot write the output
  2   wrong usage)";

} // namespace

void addSnapshot(CLI::App& app, SnapshotOptions& options) {
    app.add_flag("--dlf", options.dlf, "Write the DLF log")->required();
    app.add_option("-o,--output", options.output,
                   "The file to write (default: -, which is standard output)")
        ->type_name("FILE");
    app.add_option("FILE", options.file, "A saved snapshot")->required()->type_name("");
    app.footer(kSnapshotFooter);
}

void addInfo(CLI::App& app, InfoOptions& options) {
    app.add_flag("--json", options.json, "JSON, one object per file");
    app.add_option("RECORDING", options.files, "Recordings (pcap or pcapng) and snapshots")
        ->required()
        ->type_name("");
    app.footer(kInfoFooter);
}

void addSql(CLI::App& app, SqlOptions& options) {
    addTechnology(app, "--technology", options.technology,
                  "The technology of the recordings (default: from their link type)");
    addChoice<RowFormat>(
        app, "--format", options.format,
        {{"table", RowFormat::Table}, {"csv", RowFormat::Csv}, {"json", RowFormat::Json}},
        "A table, CSV, or JSON, one object per row (default: table)");
    app.add_option("--file", options.file, "Read the query from this file")->type_name("FILE");
    addLive(app, options.live, options.duration, options.service);
    app.add_option_function<std::string>(
           "--timeout",
           [&options](const std::string& text) {
               const auto seconds = parseSeconds(text);
               if (!seconds) {
                   throw CLI::ValidationError("--timeout", seconds.error());
               }
               options.timeout = *seconds;
           },
           "Stop a query that takes longer (default: never)")
        ->type_name("SECONDS");
    app.add_option("RECORDING", options.words, "Recordings (pcap or pcapng); then the query")
        ->type_name("");
    app.footer(kSqlFooter);
}

} // namespace pallax
