#pragma once

#include "host/HostError.h"
#include "text/Bytes.h"
#include "text/Date.h"
#include "text/Result.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

class CodeFilter;

/// A reader of a source's packets: of a recording, a stream, a simulated modem. Used only on the
/// main queue.
class PacketSource {
public:
    struct Packet {
        Time time;
        Bytes data; ///< valid until the next call
        /// See RecordedPacket.
        bool isOutOfRange = false;
    };
    enum class State {
        Packet,        ///< `packet` is set
        Later,         ///< nothing yet: use `whenReady`
        NewTechnology, ///< `technology` has another answer, which later packets are of
        End
    };
    struct Next {
        State state = State::End;
        std::optional<Packet> packet;
    };

    virtual ~PacketSource() = default;
    /// The answer to GetTechnology.
    virtual std::string technology() const = 0;
    /// From now on, packets with other log codes may be left out. A recording still gives all of
    /// them, because the player needs their times.
    virtual void select(const CodeFilter& /*wanted*/) {}
    virtual Next next() = 0;
    /// After Later: calls `ready` once, as a block of the main queue, when `next` has a new result.
    virtual void whenReady(std::function<void()> ready) = 0;
    /// Restarts with the first packet; false if the source cannot.
    virtual bool restart() = 0;
    /// After End: why the source ended early, as one sentence, or empty.
    virtual std::string failure() const = 0;
};

/// Creates the source for another log channel.
using PacketSourceFactory = std::function<Result<std::unique_ptr<PacketSource>, HostError>()>;

} // namespace pallax
