#include "telephony/SocketSink.h"

#include "host/SocketDirectory.h"
#include "host/UnixSocket.h"

#include <array>
#include <sys/socket.h>
#include <utility>

namespace pallax {

std::unique_ptr<SocketSink> SocketSink::connect(Setup setup, const SocketDirectory& directory,
                                                std::string_view portName) {
    const auto path = directory.socketPath(portName);
    Descriptor socket = path ? connectTo(*path) : Descriptor();
    if (!socket) {
        return nullptr;
    }
    return std::unique_ptr<SocketSink>(new SocketSink(std::move(setup), std::move(socket)));
}

SocketSink::SocketSink(Setup setup, Descriptor socket)
    : _setup(std::move(setup)), _socket(std::move(socket)), _watch(_setup.queue, _socket.number()),
      _alive(std::make_shared<SocketSink*>(this)) {
    watchReceiver();
}

void SocketSink::write(const FrameHeader& header, Bytes data) {
    const bool isPacket = header.kind == FrameKind::Message;
    const std::size_t size = kFrameHeaderSize + data.size();
    if (header.kind != FrameKind::End && !hasRoomFor(size)) {
        if (isPacket) {
            drop();
        }
        return; // a later time replaces one that is skipped
    }
    appendFrame(_next, header, data);
    _unflushed += size;
    _holdsEnd = _holdsEnd || header.kind == FrameKind::End;
    _packets += isPacket ? 1U : 0U;
}

/// A packet larger than the whole buffer is accepted when the buffer is empty.
bool SocketSink::hasRoomFor(std::size_t size) const {
    const std::size_t waiting = _chunk.size() - _chunkSent + _next.size();
    return !_setup.mostWaiting || waiting == 0 || waiting + size <= *_setup.mostWaiting;
}

std::size_t SocketSink::untaken() const {
    return _chunk.size() - _chunkSent + _next.size() + unreadByReceiver(_socket);
}

void SocketSink::drop() {
    ++_dropped;
    if (!std::exchange(_isBehind, true)) {
        _droppedBefore = _dropped - 1;
        if (_setup.lost) {
            _setup.lost(0);
        }
    }
}

void SocketSink::caughtUp() {
    if (std::exchange(_isBehind, false) && _setup.lost) {
        _setup.lost(_dropped - _droppedBefore);
    }
}

void SocketSink::flush(std::function<void()> done) {
    _unflushed = 0;
    if (_setup.mostWaiting && !_holdsEnd) {
        _setup.queue.async(std::move(done));
    } else {
        _done = std::move(done);
    }
    if (!_isSending) {
        sendNext();
    }
}

/// The receiver sends nothing on this connection, so readable means that it has ended.
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

void SocketSink::sendNext() {
    _chunk.swap(_next);
    _next.clear();
    _chunkSent = 0;
    _isSending = true;
    send();
}

void SocketSink::send() {
    while (_chunkSent < _chunk.size()) {
        const Transfer transfer = sendTo(_socket, Bytes(_chunk).subspan(_chunkSent));
        if (transfer.state == Transfer::State::Closed) {
            // The watch reports it, even if only sending has failed.
            (void)::shutdown(_socket.number(), SHUT_RDWR);
            return;
        }
        if (transfer.state == Transfer::State::WouldBlock) {
            _watch.onceWritable([this] { send(); });
            return;
        }
        _chunkSent += transfer.count;
        if (_chunkSent == _chunk.size() && !_next.empty()) {
            _chunk.swap(_next);
            _next.clear();
            _chunkSent = 0;
        }
    }
    _chunk.clear();
    _chunkSent = 0;
    _isSending = false;
    caughtUp();
    if (_done) {
        _setup.queue.async([weak = std::weak_ptr<SocketSink*>(_alive)] {
            if (const auto sink = weak.lock()) {
                if (const auto done = std::exchange((*sink)->_done, {})) {
                    done();
                }
            }
        });
    }
}

void SocketSink::close() {
    if (const auto closed = std::exchange(_setup.closed, {})) {
        closed();
    }
}

} // namespace pallax
