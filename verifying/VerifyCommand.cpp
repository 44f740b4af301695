#include "verifying/VerifyCommand.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "console/Output.h"
#include "decoding/DroppedNotices.h"
#include "decoding/Preconditions.h"
#include "decoding/RequiredTemplates.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/DirectoryResources.h"
#include "host/EmbeddedDigests.h"
#include "host/Files.h"
#include "host/Snapshot.h"
#include "text/Counted.h"
#include "text/Format.h"
#include "verifying/DigestDifference.h"
#include "verifying/DigestFile.h"

#include <filesystem>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

constexpr std::size_t kLargestDigestFile = std::size_t{1} << 30U; // bytes

/// What is worse to know of several recordings.
ExitStatus worse(ExitStatus one, ExitStatus other) {
    if (one == kExitFailure || other == kExitFailure) {
        return kExitFailure;
    }
    return one == kExitSuccess ? other : one;
}

} // namespace

ExitStatus VerifyCommand::couldNotTell(const std::string& sentence) {
    _environment.report(sentence);
    return kExitCouldNotTell;
}

ExitStatus VerifyCommand::run(Output& output) {
    ExitStatus status = kExitSuccess;
    for (const std::string& path : _options.recordings) {
        status = worse(status, verify(path, output));
        output.flush();
    }
    return status;
}

ExitStatus VerifyCommand::verify(const std::string& path, Output& output) {
    const std::string file = _options.expect.empty() ? digestFileOf(path) : _options.expect;
    if (recordingAmong(_options.recordings, regularFile(file))) {
        return couldNotTell(formatText("%@ is the recording itself.", {file}));
    }
    const bool isEmbedded =
        !_options.update && _options.expect.empty() && !std::filesystem::exists(file);
    if (isEmbedded && !regularFile(path)) { // which can be read only once
        return tell(embeddedIn(path, output), path, output);
    }
    const auto opened = _environment.open(path);
    if (!opened) {
        return couldNotTell(opened.error().sentence);
    }
    Recording& recording = **opened;
    if (snapshotOf(recording) != nullptr) {
        return couldNotTell(noTimeOfSnapshot(recording.name()).sentence);
    }
    if (isEmbedded) {
        return tell(embeddedIn(path, output), path, output);
    }
    if (regularFile(path)) {
        const auto check = embeddedIn(path, output);
        if (!check || !check->isSound()) {
            return kExitFailure;
        }
    }
    return compare(recording, file, output);
}

/// What the digests within the recording tell; puts out its faults.
std::optional<EmbeddedCheck> VerifyCommand::embeddedIn(const std::string& path, Output& output) {
    const std::string name = path == "-" ? "standard input" : path;
    auto content = openRecordingContent({path, {}, _environment.report}, name);
    if (!content) {
        _environment.report(content.error().sentence);
        return std::nullopt;
    }
    auto check = checkEmbeddedDigests(std::move(content).value(), name);
    for (const std::string& fault : check.faults) {
        output.text().append(name).append(": ").append(fault).append("\n");
        output.lineDone();
    }
    if (check.error) {
        _environment.report(check.error->sentence);
    }
    return check;
}

/// The verdict of the digests within the recording alone.
ExitStatus VerifyCommand::tell(const std::optional<EmbeddedCheck>& check, const std::string& path,
                               Output& output) {
    const std::string name = path == "-" ? "standard input" : path;
    if (!check) {
        return kExitCouldNotTell;
    }
    if (!check->isSound()) {
        return kExitFailure;
    }
    if (!check->hasDigests) {
        const bool mayBeKilled =
            check->isRecorded && check->packets < EmbeddedDigests::kPacketsOfBlock;
        return couldNotTell(formatText(
            "%@ has no digests%@: its %@ can be read to the end, but whether they are "
            "unchanged cannot be told; --update writes some beside it.",
            {name,
             mayBeKilled ? " (a recorder that is killed before 1,024 packets leaves none)" : "",
             counted(check->packets, "packet")}));
    }
    if (check->isWhole()) {
        output.text() +=
            formatText("%@: %@, whole and unchanged\n", {name, counted(check->packets, "packet")});
        return kExitSuccess;
    }
    const std::uint64_t covered = check->packets - check->uncovered;
    output.text() += formatText("%@: packets 1 to %llu are unchanged; ", {name, covered});
    output.text() += formatText("%@ after them without a digest: the recorder was killed, or the "
                                "end is cut off\n",
                                {counted(check->uncovered, "packet")});
    return kExitCouldNotTell;
}

/// With the digests of the file, or writes them.
ExitStatus VerifyCommand::compare(Recording& recording, const std::string& file, Output& output) {
    const auto digest = digestOf(recording, _environment.decoder);
    if (!digest) {
        _environment.report(digest.error().sentence);
        const bool isForeign = digest.error().kind == RecordingError::Kind::UnknownLinkType;
        return isForeign ? kExitCouldNotTell : kExitFailure;
    }
    if (_options.update) {
        return replaceFile(file, textOfDigest(*digest))
                   ? kExitSuccess
                   : couldNotTell(formatText("%@ cannot be written.", {file}));
    }
    const auto content = readRegularFile(file, kLargestDigestFile);
    if (!content) {
        return couldNotTell(formatText("%@ cannot be read: %@; --update writes it.",
                                       {file, content.error().reason}));
    }
    const auto before =
        digestInText({reinterpret_cast<const char*>(content->data()), content->size()}); // NOLINT
    if (!before) {
        return couldNotTell(formatText("%@ cannot be used: %@.", {file, before.error().reason}));
    }
    const auto found = differences(*before, *digest);
    for (const std::string& sentence : found) {
        output.text() += recording.name() + ": " + sentence + "\n";
        output.lineDone();
    }
    if (!found.empty()) {
        return kExitFailure;
    }
    output.text() +=
        formatText("%@: %@, as with version %@\n",
                   {recording.name(), counted(digest->packets, "packet"), before->decoder});
    return kExitSuccess;
}

ExitStatus runVerify(const VerifyOptions& options) {
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    const auto open = [](const std::string& path) {
        return Recording::openInput({path, {}, complain});
    };
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    return VerifyCommand(options, {{resources, bundle, notices, technologies()}, open, complain})
        .run(output);
}

} // namespace pallax
