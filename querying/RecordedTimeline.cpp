#include "querying/RecordedTimeline.h"

#include "host/BoundedJournal.h"
#include "host/FileWatch.h"
#include "host/JoinedRecording.h"
#include "host/RecordingJournal.h"
#include "host/Snapshot.h"
#include "text/Format.h"

#include <utility>

namespace pallax {

namespace {

constexpr std::uint64_t kPacketsBetweenCalls = 1024;

Recording::OpenResult openRecordings(const std::vector<std::string>& paths) {
    return openParts(paths, Recording::open);
}

std::string droppedText(const Recording& recording, const BoundedJournal& journal,
                        std::uint64_t limit) {
    constexpr unsigned kMebibyteShift = 20;
    const std::string dropped = formatText("%@: the packets before packet %llu were dropped",
                                           {recording.name(), journal.first()});
    return journal.trouble() ? dropped + "."
                             : formatText("%@ to keep at most %llu MiB (journal-mebibytes).",
                                          {dropped, limit >> kMebibyteShift});
}

} // namespace

struct RecordedTimeline::OpenJournal {
    std::unique_ptr<PacketJournal> journal;
    const RecordedTechnology* technology = nullptr; ///< of the link type; null if it is unknown
    std::optional<RecordingError> foreign = {};     ///< the error for an unknown link type
    std::vector<std::string> notes = {};
};

RecordedTimeline::OpenResult RecordedTimeline::openFile(const std::string& path) {
    const auto recording = Recording::open(path);
    if (!recording) {
        return recording.error();
    }
    OpenJournal opened{nullptr, (*recording)->technology()};
    if (opened.technology == nullptr) {
        opened.foreign = (*recording)->foreignLinkType();
    }
    auto journal = RecordingJournal::open(path);
    if (!journal) {
        return journal.error();
    }
    opened.journal = std::move(journal).value();
    return opened;
}

RecordedTimeline::OpenResult RecordedTimeline::keep(const Request& request) {
    const std::vector<FileWatch> files(request.recordings.begin(), request.recordings.end());
    const auto recording = openRecordings(request.recordings);
    return recording ? keep(**recording, files, request) : recording.error();
}

/// Reads a source that cannot be read again, or not in one piece.
RecordedTimeline::OpenResult RecordedTimeline::keep(Recording& recording,
                                                    const std::vector<FileWatch>& files,
                                                    const Request& request) {
    BoundedJournal::Limits limits = request.journal;
    limits.age = std::chrono::nanoseconds::max();
    auto journal = std::make_unique<BoundedJournal>(BoundedJournal::stateFolder(), limits);
    std::uint64_t packets = 0;
    while (const auto packet = recording.next()) {
        journal->add(packet->time, packet->data);
        if (request.progress && ++packets % kPacketsBetweenCalls == 0) {
            request.progress(packets);
        }
    }
    OpenJournal opened{nullptr, recording.technology()};
    if (opened.technology == nullptr) {
        opened.foreign = recording.foreignLinkType();
    }
    if (const auto& error = recording.error()) {
        opened.notes.push_back(error->sentence);
    }
    for (const FileWatch& file : files) {
        if (auto trouble = file.trouble()) {
            opened.notes.push_back(std::move(*trouble));
        }
    }
    if (journal->first() > 1) {
        opened.notes.push_back(droppedText(recording, *journal, limits.bytes));
    }
    opened.journal = std::move(journal);
    return opened;
}

Result<std::unique_ptr<RecordedTimeline>, RecordingError>
RecordedTimeline::open(const Request& request, const DecoderEnvironment& environment) {
    const bool isFile =
        request.recordings.size() == 1 && RecordingJournal::isSuitable(request.recordings.front());
    auto opened = isFile ? openFile(request.recordings.front()) : keep(request);
    if (!opened) {
        return opened.error();
    }
    return index(std::move(opened).value(), request, environment);
}

Result<std::unique_ptr<RecordedTimeline>, RecordingError>
RecordedTimeline::openStream(Recording& stream, const Request& request,
                             const DecoderEnvironment& environment) {
    auto opened = keep(stream, {}, request);
    if (!opened) {
        return opened.error();
    }
    return index(std::move(opened).value(), request, environment);
}

Result<std::unique_ptr<RecordedTimeline>, RecordingError>
RecordedTimeline::index(OpenJournal journal, const Request& request,
                        const DecoderEnvironment& environment) {
    const RecordedTechnology* technology =
        request.technology != nullptr ? request.technology : journal.technology;
    if (technology == nullptr) {
        return *journal.foreign;
    }
    if (journal.technology == &kSnapshotTechnology) {
        const std::string& path = request.recordings.front();
        return noTimeOfSnapshot(path == "-" ? "standard input" : path);
    }
    std::unique_ptr<RecordedTimeline> made(new RecordedTimeline);
    made->_journal = request.through ? request.through(std::move(journal.journal), *technology)
                                     : std::move(journal.journal);
    made->_notes = std::move(journal.notes);
    made->_timeline = std::make_unique<Timeline>(
        *made->_journal, DecodingSource{*technology, environment.resources, environment.bundle,
                                        environment.technologies});
    (void)made->_timeline->index([&] {
        if (request.progress) {
            request.progress(made->_timeline->packets());
        }
        return true;
    });
    return made;
}

std::vector<std::string> RecordedTimeline::notes() const {
    std::vector<std::string> notes = _notes;
    for (std::string& note : _timeline->notes()) {
        notes.push_back(std::move(note));
    }
    return notes;
}

} // namespace pallax
