#pragma once

#include "host/Descriptor.h"
#include "host/HostError.h"
#include "sources/PacketSource.h"
#include "sources/Source.h"
#include "text/Result.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

class AsioMainQueue;
class Relay;

/// What a source needs of its surroundings.
struct SourceSurroundings {
    /// A stream is read for all its readers at once.
    struct Relaying {
        std::chrono::nanoseconds patience; ///< how long the stream waits for its first reader
        /// Called once after the stream's end; `isOrderly` if it was between two packets.
        std::function<void(bool isOrderly)> ended;
    };

    AsioMainQueue& queue;                                    ///< outlives the source
    std::function<void(const std::string& sentence)> report; ///< a sentence for each problem
    std::optional<Relaying> relaying = std::nullopt;         ///< otherwise, a stream has one reader
};

/// A source that can be read, and its readers' packets.
struct OpenSource {
    std::string technology;
    PacketSourceFactory makeReader;
    std::shared_ptr<Relay> relay = nullptr; ///< null unless the source is relayed
    std::vector<Descriptor> reading = {};   ///< keep recorders from replacing the recording
};

/// Opens a source of packets: a recording, a simulated modem or a modem of this
/// machine. Fails at once if nothing could be
/// read from it, as from the service's modem, whose packets come through the service alone.
Result<OpenSource, HostError> openSource(const Source& source, SourceSurroundings surroundings);

} // namespace pallax
