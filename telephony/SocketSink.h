#pragma once

#include "host/AsioMainQueue.h"
#include "host/Descriptor.h"
#include "telephony/PacketSink.h"

#include <memory>

namespace pallax {

class SocketDirectory;

/// The connection of a log channel to the local port that it feeds.
class SocketSink final : public PacketSink {
public:
    /// Null when nobody listens under that name. `closed` is called once, as a block, when the
    /// receiver ends the connection; it may destroy the sink.
    static std::unique_ptr<SocketSink> connect(AsioMainQueue& queue,
                                               const SocketDirectory& directory,
                                               std::string_view portName,
                                               std::function<void()> closed);

    void write(const FrameHeader& header, Bytes data) override;
    std::size_t pending() const override { return _chunk.size(); }
    void flush(std::function<void()> done) override;

private:
    SocketSink(AsioMainQueue& queue, Descriptor socket, std::function<void()> closed);
    void watchReceiver();
    void send();
    void close();

    AsioMainQueue& _queue;
    Descriptor _socket;
    DescriptorWatch _watch; // after the socket that it watches
    std::function<void()> _closed;
    ByteBuffer _chunk;
    std::size_t _sent = 0;
    std::function<void()> _done;
    std::shared_ptr<SocketSink*> _alive; // blocks hold it weakly
};

} // namespace pallax
