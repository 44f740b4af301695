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

/// Where the packets of a log channel come from: a recording, a stream, a simulated modem.
/// Everything happens on the main queue.
class PacketSource {
public:
    struct Packet {
        Time time;
        Bytes data; ///< valid until the next call
        /// See RecordedPacket.
        bool isOutOfRange = false;
    };
    enum class State {
        Packet, ///< `packet` is set
        Later,  ///< nothing yet: `whenReady` will tell
        End
    };
    struct Next {
        State state = State::End;
        std::optional<Packet> packet;
    };

    virtual ~PacketSource() = default;
    /// What GetTechnology is answered with.
    virtual std::string technology() const = 0;
    virtual Next next() = 0;
    /// After Later: calls `ready` once, as a block of the main queue, when `next` has more to say.
    virtual void whenReady(std::function<void()> ready) = 0;
    /// Begins again with the first packet; false when the source cannot.
    virtual bool restart() = 0;
    /// After End: why the source ended before its time, as one sentence; empty when it did not.
    virtual std::string failure() const = 0;
};

/// Makes the source of one more log channel.
using PacketSourceFactory = std::function<Result<std::unique_ptr<PacketSource>, HostError>()>;

} // namespace pallax
