#pragma once

#include "host/AsioMainQueue.h"
#include "host/Descriptor.h"
#include "telephony/PacketSink.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>

namespace pallax {

class SocketDirectory;

/// The connection of a log channel to the local port that it feeds.
///
/// Either the receiver sets the pace and nothing is lost, or the sink buffers packets up to a
/// limit; packets that do not fit are dropped and counted. The end of the source always waits for
/// the receiver.
class SocketSink final : public PacketSink {
public:
    struct Setup {
        AsioMainQueue& queue;
        /// Bytes that may wait for a slow receiver; nothing: the receiver sets the pace.
        std::optional<std::size_t> mostWaiting;
        /// Called once, as a block, when the receiver ends the connection; it may destroy the sink.
        std::function<void()> closed;
        /// Called with 0 when the first packet is dropped, and with the number of dropped packets
        /// when the receiver has caught up.
        std::function<void(std::uint64_t count)> lost;
    };

    /// Null if there is no listener with this name.
    static std::unique_ptr<SocketSink> connect(Setup setup, const SocketDirectory& directory,
                                               std::string_view portName);

    void write(const FrameHeader& header, Bytes data) override;
    std::size_t pending() const override { return _unflushed; }
    void flush(std::function<void()> done) override;

    /// All bytes that the receiver has not read yet.
    std::size_t untaken() const;
    std::uint64_t sent() const { return _packets; }    ///< packets, including waiting ones
    std::uint64_t dropped() const { return _dropped; } ///< packets

private:
    SocketSink(Setup setup, Descriptor socket);
    bool hasRoomFor(std::size_t size) const;
    void drop();
    void caughtUp();
    void watchReceiver();
    void sendNext();
    void send();
    void close();

    Setup _setup;
    Descriptor _socket;
    DescriptorWatch _watch;     // declared after the socket that it watches
    ByteBuffer _chunk;          // being sent
    std::size_t _chunkSent = 0; // bytes of it sent so far
    bool _isSending = false;
    ByteBuffer _next; // the frames after it
    std::size_t _unflushed = 0;
    bool _holdsEnd = false;
    std::uint64_t _packets = 0;
    std::uint64_t _dropped = 0;
    std::uint64_t _droppedBefore = 0; // before the receiver fell behind
    bool _isBehind = false;
    std::function<void()> _done;
    std::shared_ptr<SocketSink*> _alive; // held weakly by blocks
};

} // namespace pallax
