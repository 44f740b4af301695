#include "telephony/SocketSink.h"

#include "host/SocketDirectory.h"
#include "host/UnixSocket.h"

#include <array>
#include <utility>

namespace pallax {

std::unique_ptr<SocketSink> SocketSink::connect(AsioMainQueue& queue,
                                                const SocketDirectory& directory,
                                                std::string_view portName,
                                                std::function<void()> closed) {
    const auto path = directory.socketPath(portName);
    Descriptor socket = path ? connectTo(*path) : Descriptor();
    if (!socket) {
        return nullptr;
    }
    return std::unique_ptr<SocketSink>(new SocketSink(queue, std::move(socket), std::move(closed)));
}

SocketSink::SocketSink(AsioMainQueue& queue, Descriptor socket, std::function<void()> closed)
    : _queue(queue), _socket(std::move(socket)), _watch(queue, _socket.number()),
      _closed(std::move(closed)), _alive(std::make_shared<SocketSink*>(this)) {
    watchReceiver();
}

void SocketSink::write(const FrameHeader& header, Bytes data) {
    appendFrame(_chunk, header, data);
}

void SocketSink::flush(std::function<void()> done) {
    _done = std::move(done);
    _sent = 0;
    send();
}

/// The receiver sends nothing on this connection; what can be read is its end.
void SocketSink::watchReceiver() {
    _watch.onceReadable([this] {
        std::array<std::uint8_t, 1> nothing{};
        if (receiveFrom(_socket, nothing).state == Transfer::State::WouldBlock) {
            watchReceiver();
        } else {
            close();
        }
    });
}

void SocketSink::send() {
    while (_sent < _chunk.size()) {
        const Transfer transfer = sendTo(_socket, Bytes(_chunk).subspan(_sent));
        if (transfer.state == Transfer::State::Closed) {
            return; // the watch for reading tells it
        }
        if (transfer.state == Transfer::State::WouldBlock) {
            _watch.onceWritable([this] { send(); });
            return;
        }
        _sent += transfer.count;
    }
    _chunk.clear();
    _queue.async([weak = std::weak_ptr<SocketSink*>(_alive)] {
        if (const auto sink = weak.lock()) {
            if (const auto done = std::exchange((*sink)->_done, {})) {
                done();
            }
        }
    });
}

void SocketSink::close() {
    if (const auto closed = std::exchange(_closed, {})) {
        closed();
    }
}

} // namespace pallax
