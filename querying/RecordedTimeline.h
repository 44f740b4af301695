#pragma once

#include "decoding/RecordingDecoder.h"
#include "host/BoundedJournal.h"
#include "host/Recording.h"
#include "packets/PacketJournal.h"
#include "text/Result.h"
#include "timeline/Timeline.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace pallax {

class FileWatch;

/// A recording, or several as one, that can be asked about any instant.
class RecordedTimeline {
public:
    struct Request {
        std::vector<std::string>
            recordings; ///< not empty; several are one, in order of their times
        const RecordedTechnology* technology = nullptr; ///< overrides the link type
        /// For what cannot be read again; its age does not count, as a whole recording is wanted.
        BoundedJournal::Limits journal = {};
        /// Called now and then with the number of packets that were read.
        std::function<void(std::uint64_t packets)> progress = {};
        /// Stands between the packets and everything that reads them, such as a mask.
        std::function<std::unique_ptr<PacketJournal>(std::unique_ptr<PacketJournal> packets,
                                                     const RecordedTechnology& technology)>
            through = {};
    };

    /// Opens the recordings and reads them once. A file is read again where it is needed; of a
    /// stream, and of several recordings, the latest packets are kept.
    static Result<std::unique_ptr<RecordedTimeline>, RecordingError>
    open(const Request& request, const DecoderEnvironment& environment);

    /// The same of a stream that has been opened; the request names it.
    static Result<std::unique_ptr<RecordedTimeline>, RecordingError>
    openStream(Recording& stream, const Request& request, const DecoderEnvironment& environment);

    Timeline& timeline() { return *_timeline; }
    /// Sentences about what is missing or damaged; empty if all is well.
    std::vector<std::string> notes() const;

private:
    struct OpenJournal;
    using OpenResult = Result<OpenJournal, RecordingError>;

    RecordedTimeline() = default;
    static OpenResult openFile(const std::string& path);
    static OpenResult keep(const Request& request);
    static OpenResult keep(Recording& recording, const std::vector<FileWatch>& files,
                           const Request& request);
    static Result<std::unique_ptr<RecordedTimeline>, RecordingError>
    index(OpenJournal journal, const Request& request, const DecoderEnvironment& environment);

    std::unique_ptr<PacketJournal> _journal; // outlives the timeline
    std::unique_ptr<Timeline> _timeline;
    std::vector<std::string> _notes;
};

} // namespace pallax
