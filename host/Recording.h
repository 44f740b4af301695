#pragma once

#include "platform/RecordedTechnology.h"
#include "text/Bytes.h"
#include "text/Date.h"
#include "text/Result.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// One packet of a recording, exactly as the log channel delivered it.
struct RecordedPacket {
    Time time;
    Bytes data; ///< valid until the next call
    /// The stamp was outside kEarliestTime to kLatestTime; the nearest time replaces it.
    bool isOutOfRange = false;
};

/// Why a recording cannot be opened or read further: one sentence that names the file.
struct RecordingError {
    enum class Kind { CannotOpen, NoCapture, Empty, UnknownLinkType, CutShort, Unreadable };
    Kind kind;
    std::string sentence;
};

/// A recording, read packet by packet: pcap or pcapng, microsecond or nanosecond stamps, plain or
/// compressed with gzip or zstd.
class Recording {
public:
    using OpenResult = Result<std::unique_ptr<Recording>, RecordingError>;
    /// Receives a sentence if a stream does not deliver anything yet.
    using Waiting = std::function<void(std::string_view sentence)>;

    struct Input {
        std::string path;      ///< "-" is standard input
        std::string name = {}; ///< for messages; if empty, the path
        Waiting waiting = {};
    };

    /// A file of zero bytes is Empty, any other file that is not a capture is NoCapture. A capture
    /// without packets is not an error. A saved snapshot is a recording with a message for each of
    /// its displays (host/Snapshot.h).
    static OpenResult openInput(const Input& input);
    static OpenResult open(const std::string& path) { return openInput({path}); }

    virtual ~Recording() = default;
    virtual const std::string& name() const = 0; ///< as given; "standard input" for "-"
    /// Whether it can be read only once: standard input, a named pipe or a device.
    virtual bool isStream() const { return false; }
    /// "pcap", "pcapng", "gzip of pcap", …
    virtual std::string format() const { return {}; }
    virtual int linkType() const = 0;
    /// Null for an unknown link type; callers that know the technology from an option may ignore
    /// that.
    virtual const RecordedTechnology* technology() const = 0;
    /// The error for an unknown link type: names the file, the number and the five known ones.
    virtual RecordingError foreignLinkType() const = 0;
    /// The next packet; nothing at the end, or when `error` is set.
    virtual std::optional<RecordedPacket> next() = 0;
    /// How many bytes of the file have been read, in its compressed form; nothing for a pipe.
    virtual std::optional<std::uint64_t> position() const { return std::nullopt; }
    /// Goes on at a position that was given before a packet. Only for a file in which nothing but
    /// packets follows the first packet. False if this is not possible.
    virtual bool seek(std::uint64_t /*position*/) { return false; }
    /// Set once `next` has returned nothing because the recording is truncated in a packet or
    /// cannot be read further.
    virtual const std::optional<RecordingError>& error() const = 0;
};

} // namespace pallax
