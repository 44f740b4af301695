#include "decoding/InfoCommand.h"

#include "console/Output.h"
#include "decoding/Preconditions.h"
#include "decoding/RequiredTemplates.h"
#include "decoding/SnapshotText.h"
#include "decoding/SummaryText.h"
#include "host/Complaint.h"
#include "host/JoinedRecording.h"
#include "host/Snapshot.h"
#include "host/WallClock.h"

#include <unistd.h>
#include <utility>

namespace pallax {

ExitStatus InfoCommand::run(Output& output) {
    ExitStatus status = kExitSuccess;
    for (const PartPaths& parts : joinedParts(_options.files, _environment.open)) {
        const ExitStatus result = describe(parts, output);
        status = result == kExitSuccess ? status : result;
        output.flush(); // the next file may have to be waited for
    }
    return status;
}

ExitStatus InfoCommand::describe(const PartPaths& parts, Output& output) {
    if (const auto missing = missingParts(parts)) {
        _environment.report(*missing);
    }
    const Recording::OpenResult recording = openParts(parts, _environment.open);
    if (!recording) {
        _environment.report(recording.error().sentence);
        return kExitFailure;
    }
    if (const Snapshot* snapshot = snapshotOf(**recording)) {
        describe(*snapshot, (*recording)->name(), output);
        return kExitSuccess;
    }
    return describe(**recording, output);
}

void InfoCommand::describe(const Snapshot& snapshot, const std::string& name, Output& output) {
    if (_options.json) {
        appendSnapshotJson(output.text(), name, snapshot);
    } else {
        separate(output);
        appendSnapshotText(output.text(), name, snapshot);
    }
    output.lineDone();
}

/// Begins the text of a file.
void InfoCommand::separate(Output& output) {
    output.text() += std::exchange(_isFirst, false) ? "" : "\n";
}

ExitStatus InfoCommand::describe(Recording& recording, Output& output) {
    const RecordingSummary::Codes* codes = codesOf(recording.technology());
    RecordingSummary summary(codes);
    while (const auto packet = recording.next()) {
        summary.add(*packet);
    }
    const SummarizedFile file{recording, summary, codes};
    if (_options.json) {
        appendSummaryJson(output.text(), file);
    } else {
        separate(output);
        appendSummaryText(output.text(), file, _environment.zone);
    }
    output.lineDone();
    if (recording.error()) {
        _environment.report(recording.error()->sentence);
        return kExitFailure;
    }
    if (recording.technology() == nullptr) {
        _environment.report(recording.foreignLinkType().sentence);
        return kExitFailure;
    }
    return kExitSuccess;
}

const RecordingSummary::Codes* InfoCommand::codesOf(const RecordedTechnology* technology) {
    if (technology == nullptr) {
        return nullptr;
    }
    auto found = _codes.find(technology);
    if (found == _codes.end()) {
        const auto reference = gatherReference(*technology, _environment.resources);
        found = _codes.emplace(technology, RecordingSummary::Codes(reference)).first;
    }
    return &found->second;
}

ExitStatus runInfo(const InfoOptions& options) {
    if (const auto loss = outputIntoRecording(options.files)) {
        complain(*loss);
        return kExitFailure;
    }
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const WallClock zone;
    const auto open = [](const std::string& path) {
        return Recording::openInput({path, {}, complain});
    };
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    return InfoCommand(options, {resources, zone, open, complain}).run(output);
}

} // namespace pallax
