#pragma once

#include "host/PortFrame.h"

#include <cstddef>
#include <functional>

namespace pallax {

/// Where a player's frames go: the receiving end of a log channel.
class PacketSink {
public:
    virtual ~PacketSink() = default;
    /// Appends a frame to the present chunk.
    virtual void write(const FrameHeader& header, Bytes data) = 0;
    /// Bytes in the present chunk.
    virtual std::size_t pending() const = 0;
    /// Sends the chunk and calls `done`, as a block of the main queue: as late as the receiver
    /// makes it, or at once where the sink keeps what the receiver has no time for. Nothing is
    /// written meanwhile. After the receiver has gone `done` need not be called.
    virtual void flush(std::function<void()> done) = 0;
};

} // namespace pallax
