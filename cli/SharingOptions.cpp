#include "cli/SharingOptions.h"

#include "masking/MaskCommand.h"
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
