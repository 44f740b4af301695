#pragma once

#include "text/Bytes.h"
#include "text/Date.h"
#include "text/Result.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>

namespace pallax {

/// What a radio modem's recording can be of, told by its link type; the identifier is the one
/// that the telephony service answers GetTechnology with.
struct RecordedTechnology {
    int linkType;                 ///< 147 … 151
    std::string_view identifier;  ///< "Zorell_GSM"
    std::string_view commandName; ///< "gsm", as the command line says it
};

/// The five known technologies, by link type.
std::span<const RecordedTechnology> recordedTechnologies();
const RecordedTechnology* technologyOfLinkType(int linkType);
const RecordedTechnology* technologyOfCommandName(std::string_view name);

/// One packet of a recording, exactly as the log channel delivered it.
struct RecordedPacket {
    Time time;
    Bytes data; ///< valid until the next call
    /// The stamp is no time from kEarliestTime to kLatestTime; the nearest one is taken.
    bool isOutOfRange = false;
};

/// Why a recording cannot be opened or read on: one clear sentence that names the file.
struct RecordingError {
    enum class Kind { CannotOpen, NoCapture, Empty, UnknownLinkType, CutShort, Unreadable };
    Kind kind;
    std::string sentence;
};

/// A recording that is read packet by packet: pcap or pcapng, microsecond or nanosecond stamps.
class Recording {
public:
    using OpenResult = Result<std::unique_ptr<Recording>, RecordingError>;
    /// Hears, as one sentence, that a stream gives nothing yet.
    using Waiting = std::function<void(std::string_view sentence)>;

    struct Input {
        std::string path;      ///< "-" is standard input
        std::string name = {}; ///< for sentences; the path where it is empty
        Waiting waiting = {};
    };

    /// A file of zero bytes is Empty, anything else that is no capture is NoCapture. A capture
    /// without packets is no error.
    static OpenResult openInput(const Input& input);
    static OpenResult open(const std::string& path) { return openInput({path}); }

    virtual ~Recording() = default;
    virtual const std::string& name() const = 0; ///< as given; "standard input" for "-"
    /// Whether it can be read only once: standard input, or a stream by name.
    virtual bool isStream() const { return false; }
    virtual int linkType() const = 0;
    /// Null for a link type that is none of the five; whoever has been told the technology by
    /// other means (an option) need not care.
    virtual const RecordedTechnology* technology() const = 0;
    /// The sentence for a foreign link type: names the file, the number and the five known ones.
    virtual RecordingError foreignLinkType() const = 0;
    /// The next packet; nothing at the end, or when `error` has something to say.
    virtual std::optional<RecordedPacket> next() = 0;
    /// How many bytes of the file the packets so far have taken; nothing for a pipe.
    virtual std::optional<std::uint64_t> position() const { return std::nullopt; }
    /// Set once `next` has given nothing because the recording is cut in the middle of a packet,
    /// or cannot be read on.
    virtual const std::optional<RecordingError>& error() const = 0;
};

} // namespace pallax
