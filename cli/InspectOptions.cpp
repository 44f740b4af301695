#include "cli/InspectOptions.h"

#include "decoding/InfoCommand.h"

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

"fills" names the sections that the recording has data for, "leaves" the others.
A file that is cut or damaged is described as far as it can be read.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: cannot read a file or template, or write the output
  2   wrong usage)";

} // namespace

void addInfo(CLI::App& app, InfoOptions& options) {
    app.add_flag("--json", options.json, "JSON, one object per file");
    app.add_option("RECORDING", options.files, "Recordings (pcap or pcapng)")
        ->required()
        ->type_name("");
    app.footer(kInfoFooter);
}

} // namespace pallax
