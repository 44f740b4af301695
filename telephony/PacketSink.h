#pragma once

#include "host/PortFrame.h"

#include <cstddef>
#include <functional>

namespace pallax {

/// The receiver of a player's frames: the end of a log channel.
class PacketSink {
public:
    virtual ~PacketSink() = default;
    /// Appends a frame to the current chunk.
    virtual void write(const FrameHeader& header, Bytes data) = 0;
    /// The size of the current chunk in bytes.
    virtual std::size_t pending() const = 0;
    /// Sends the chunk and calls `done` as a block of the main queue: once the receiver has taken
    /// it, or at once if the sink buffers for a slow receiver. No write may happen in between. If
    /// the receiver has gone, `done` may not be called.
    virtual void flush(std::function<void()> done) = 0;
};

} // namespace pallax
