#include "cli/SharingOptions.h"

#include "cli/OptionParts.h"
#include "masking/MaskCommand.h"
#include "reporting/ReportCommand.h"
#include "verifying/VerifyCommand.h"

#include <CLI/CLI.hpp>

namespace pallax {

namespace {

constexpr const char* kMaskFooter = R"(Examples:
  pallax mask drive.pcapng -o shared.pcapng
  pallax mask --check shared.pcapng
  pallax mask --pseudonyms key --coarse-place monday/*.pcapng -o shared/

The copy is the same file without what identifies a person: the fields marked
"personal" in pallax fields --json, other files of a SIM, and, in an object
stream or a snapshot, values whose key names an identity or that look like one.
Their bytes become zeros and their texts "000"; everything else stays byte for
byte, and all numbers and times of packets. A payload that cannot be understood,
comments and blocks of unknown types are zeroed too, unless --keep-unknown is
given; what was masked and zeroed is counted on standard error. The raw bytes in
a snapshot are always zeroed. A compressed file becomes a plain one.

FIELD is the name of a field or its end (iccid, ef_iccid, gsm.sim_info.*).

With --pseudonyms, the same value gets the same pseudonym everywhere, which
depends only on it and on the key (HMAC-SHA-256). KEYFILE holds at least 16
bytes that only you may read, such as those of
  (umask 077; head -c 32 /dev/urandom > key)

--coarse-place replaces the identities of cells and areas: two readings still
show whether the cell was the same. Without --pseudonyms, the key for that is
forgotten.

--check tells where files hold what looks like an identity: personal fields that
are not masked; an IMSI with an assigned country code; an IMEI or ICCID with a
valid check digit; a phone number in international form. It looks at texts,
UTF-16, packed digits, and what is encoded in property lists.

What records tell about a person, and what cannot be masked, is described in
pallax-privacy(7).

The copy can be read by you alone. It appears when it is complete; if a file is
cut or damaged, there is none.

Exit status:
  0   success; with --check, nothing was found
  1   failure; with --check, something was found, or a file cannot be read
  2   wrong usage)";

constexpr const char* kReportFooter = R"(Examples:
  pallax report drive.pcap -o drive.html
  pallax report before.pcap after.pcap -o compared.html
  pallax report --from 14:02 --to 14:30 --track walk.gpx drive.pcap -o walk.html
  pallax report --json drive.pcap | jq '.measures[].quantiles'
  pallax report --store fleet.db --device car1 --from 2026-11-20 -o car1.html

The page is one file that any browser opens, without a network: a verdict on
each level, curves, the cells and states over time, neighbours, events, and the
whole state at each display tick, which is every two seconds. Two recordings
are shown beside each other. The numbered parts of one (drive-0001.pcapng,
drive-0002.pcapng) are read as one. A store is a file, or an address of one on a
server (clickhouse://HOST/DATABASE).

Levels, cells and states are those that the display shows at its ticks. Each
stands for the time until the next tick, at most 10 s. Shares of time, the
values that were not exceeded for 5, 50 and 95 % of it, and the worst minute
(the least mean) follow from that. A level that was read more than 10 s ago is
not known any more. Events are those of pallax events.

What identifies a person is left out: the fields that pallax mask masks. The
page says so where it was, or that --with-identities was given. Identities of
cells stay. Of a path, only the name of the file is shown. --label names the
device; of two recordings, the first --label is for the first.

Where the clock was set back, the page shows each stretch of time by itself.

--where takes a condition as pallax decode does; the report then has only the
ticks for which it holds. --track draws the way that a GPX file describes,
without a map. --json prints an object for each recording, with times in
seconds since 1970.

With --store, the page shows what a store of measurements (see pallax store)
holds of a device, all recordings of one technology as one. A store does not
hold the display, so the page has no state at each tick, and says so.
Identities and their pseudonyms stay out.

The same input gives the same bytes. The page can be read by you alone. It
appears when it is complete.

Exit status:
  0   success, or the reader of the output has gone
  1   failure, or something is missing, as a sentence on standard error tells
  2   wrong usage, or a wrong condition
  70  a fatal record ends the report)";

constexpr const char* kVerifyFooter = R"(Examples:
  pallax verify --update drive.pcapng
  pallax verify drive.pcapng
  pallax verify --expect as-it-should-be.pallax-verify drive.pcapng

--update writes what a recording is to RECORDING.pallax-verify: the number of
its packets, a digest of each block of 1024 packets with their times, and a
digest of each field's values in each minute. Later, verify tells which packets
have changed, and which fields decode otherwise in which minutes, such as after
an update. --expect reads, or with --update writes, another file: a recording
with such a file says what is expected of a decoder.

Without such a file, verify asks the digests that pallax record writes into its
pcapng files, one for each 1024 packets and one at the end, and tells whether
the recording is whole and unchanged. If the recorder was killed, or the end
of the file is lost, the packets after the last digest have none, and verify
says how many: status 3. A recorder that is killed before 1024 packets leaves
no digest at all.

The digests (SHA-256) show damage and drift. They do not show forgery: who
changes a recording can write them anew. Those beside a recording do not show
damage to what is not a packet, such as a comment; those within it do.

Exit status:
  0   every recording is what it was; with --update, the digests are written
  1   one is not: it is cut or damaged, has changed, or decodes otherwise
  2   wrong usage
  3   could not tell: no digests, or a file cannot be read or written)";

} // namespace

void addVerify(CLI::App& app, VerifyOptions& options) {
    app.add_flag("--update", options.update, "Write the digests instead");
    app.add_option("--expect", options.expect,
                   "The file of digests (default: RECORDING.pallax-verify)")
        ->type_name("FILE");
    app.add_option("RECORDING", options.recordings, "Recordings (pcap or pcapng)")
        ->required()
        ->type_name("");
    app.footer(kVerifyFooter);
}

void addReport(CLI::App& app, ReportOptions& options) {
    app.add_option("-o,--output", options.output, "The page to write; - is standard output")
        ->type_name("FILE");
    app.add_flag("--json", options.json, "Write the figures alone, as JSON");
    addTechnology(app, "--technology", options.technology,
                  "The technology of the recordings (default: from their link type)");
    app.add_option("--profile", options.profile,
                   "The profile that judges levels (default: android)")
        ->type_name("android|field|operator|NAME");
    addTime(app, "--from", options.from, "Begin at this time");
    addTime(app, "--to", options.to, "End at this time");
    CLI::Option* where =
        app.add_option("--where", options.where, "Only the display ticks for which this holds")
            ->type_name("CONDITION");
    app.add_option("--title", options.title, "The title of the page")->type_name("TEXT");
    app.add_option("--label", options.labels, "What the device is called, once for each recording")
        ->type_name("TEXT")
        ->allow_extra_args(false);
    app.add_option("--track", options.track, "Draw the way in this GPX file")->type_name("FILE");
    CLI::Option* identities = app.add_flag("--with-identities", options.withIdentities,
                                           "Keep what identifies a person, and say so");
    CLI::Option* store =
        app.add_option("--store", options.store, "Report what this store holds of a device instead")
            ->type_name("FILE");
    app.add_option("--device", options.device, "The device of the store (default: the only one)")
        ->type_name("NAME")
        ->needs(store);
    CLI::Option* recordings =
        app.add_option("RECORDING", options.recordings, "Recordings (pcap or pcapng)")
            ->type_name("");
    for (CLI::Option* option : {recordings, where, identities}) {
        store->excludes(option);
    }
    app.callback([store, recordings] {
        if (store->empty() && recordings->empty()) {
            throw CLI::RequiredError("RECORDING or --store");
        }
    });
    app.footer(kReportFooter);
}

void addMask(CLI::App& app, MaskOptions& options) {
    CLI::Option* output = app.add_option("-o,--output", options.output,
                                         "The masked file or, for several files, their folder")
                              ->type_name("FILE");
    CLI::Option* check =
        app.add_flag("--check", options.check, "Find identities instead, and tell where they are")
            ->excludes(output);
    app.add_option("--keep", options.choice.keep, "Do not mask this field")
        ->type_name("FIELD")
        ->allow_extra_args(false)
        ->excludes(check);
    app.add_option("--also", options.choice.also, "Mask this field, too")
        ->type_name("FIELD")
        ->allow_extra_args(false)
        ->excludes(check);
    app.add_flag("--coarse-place", options.choice.coarsePlace,
                 "Replace the identities of cells and areas")
        ->excludes(check);
    app.add_option("--pseudonyms", options.keyFile, "Replace by pseudonyms instead of zeros")
        ->type_name("KEYFILE")
        ->excludes(check);
    app.add_flag("--keep-unknown", options.choice.keepUnknown,
                 "Keep what cannot be understood, which may hold anything")
        ->excludes(check);
    app.add_option("FILE", options.files, "Recordings (pcap or pcapng) and saved snapshots")
        ->required()
        ->type_name("");
    app.footer(kMaskFooter);
}

} // namespace pallax
