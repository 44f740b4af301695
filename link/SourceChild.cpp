#include "link/SourceChild.h"

#include "decoding/Preconditions.h"
#include "decoding/SnapshotDisplay.h"
#include "host/Complaint.h"
#include "host/JoinedRecording.h"
#include "host/RecordingFile.h"
#include "host/Snapshot.h"
#include "telephony/ChildService.h"

#include <utility>

namespace pallax {

std::optional<std::string> refusalOf(const Source& source) {
    const auto* file = std::get_if<FileRecording>(&source);
    if (file == nullptr) {
        return std::nullopt;
    }
    const Recording::OpenResult recording = openParts(file->parts(), Recording::open);
    if (!recording) {
        return std::nullopt; // the child service reports it, as for an unknown link type
    }
    return missingGenerator(**recording, technologiesWithSnapshots(SnapshotDisplays::Together));
}

bool isSnapshot(const Source& source) {
    const auto* file = std::get_if<FileRecording>(&source);
    if (file == nullptr) {
        return false;
    }
    const Recording::OpenResult recording = Recording::open(file->path);
    return recording && (*recording)->technology() == &kSnapshotTechnology;
}

Result<std::unique_ptr<ChildService>, HostError> startChild(const Source& source,
                                                            const PlayOptions& play) {
    const auto* stream = std::get_if<StreamedRecording>(&source);
    if (stream == nullptr || stream->path == "-") {
        auto started = ChildService::start({source, play});
        if (started && isLive(source)) {
            (void)(*started)->takeComplaints(); // the picture says what is waited for
        }
        return started;
    }
    auto opened = RecordingFile::open(stream->path, complain);
    if (!opened) {
        return HostError{opened.error().sentence};
    }
    return ChildService::start({StreamedRecording{"-", stream->path}, play},
                               std::move(opened).value().descriptor);
}

bool endChild(ChildService& child) {
    child.stop();
    const std::string complaints = child.takeComplaints(); // lines that start with the program's
                                                           // name
    passOnComplaints(complaints);
    return complaints.empty();
}

std::string lostChildSentence(const Source& source) {
    return recordingPath(source) ? "The service that plays the recording has ended."
           : isLive(source)      ? "The service that watches the modem has ended."
                                 : "The service that simulates the modem has ended.";
}

} // namespace pallax
