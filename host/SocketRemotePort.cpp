#include "host/SocketRemotePort.h"

#include "host/AsioMainQueue.h"
#include "host/PortFrame.h"
#include "host/UnixSocket.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <poll.h>

namespace pallax {

namespace {

using SteadyTime = std::chrono::steady_clock::time_point;

SteadyTime deadlineIn(std::chrono::nanoseconds timeout) {
    constexpr std::chrono::nanoseconds kLongest = std::chrono::hours(24);
    return std::chrono::steady_clock::now() +
           std::clamp(timeout, std::chrono::nanoseconds::zero(), kLongest);
}

enum class Direction { Read, Both };

/// Waits until bytes can be moved; false after the deadline, even if the peer is busy.
bool waitFor(const Descriptor& socket, Direction direction, SteadyTime deadline) {
    for (;;) {
        const auto left = std::chrono::ceil<std::chrono::milliseconds>(
            deadline - std::chrono::steady_clock::now());
        if (left.count() <= 0) {
            return false;
        }
        const auto events =
            static_cast<short>(direction == Direction::Both ? POLLIN | POLLOUT : POLLIN);
        pollfd entry{socket.number(), events, 0};
        if (::poll(&entry, 1, static_cast<int>(left.count())) > 0) {
            return true;
        }
    }
}

} // namespace

struct SocketRemotePort::State : std::enable_shared_from_this<State> {
    State(AsioMainQueue& mainQueue, Descriptor connection)
        : queue(mainQueue), socket(std::move(connection)),
          watch(std::make_unique<DescriptorWatch>(queue, socket.number())) {}

    void watchPeer() {
        watch->onceReadable([this] {
            if (receive()) {
                watchPeer();
            }
        });
    }
    bool receive();
    bool takeFrame(PortFrame frame);
    SendError send(Bytes header, Bytes data, SteadyTime deadline);
    bool sendRest();
    Outcome awaitReply(SteadyTime deadline);
    bool peerEnded();

    AsioMainQueue& queue;
    Descriptor socket;
    std::unique_ptr<DescriptorWatch> watch; // declared after the socket that it watches; null at
                                            // the end
    SocketRemotePort* port = nullptr;
    InvalidationCallback invalidated;
    PortFrameParser parser;
    std::uint32_t requestNumber = 0;
    std::optional<PortFrame> reply; // to the current request
    /// The rest of a frame whose send timed out in the middle: it must precede the next.
    ByteBuffer unsent;
};

/// Reads what has arrived. From a peer that never stops, reads only a limited amount, so that
/// others get their turn and deadlines are checked. False if the connection has ended.
bool SocketRemotePort::State::receive() {
    constexpr std::size_t kPieceSize = std::size_t{16} << 10U;
    constexpr int kMostChunks = 16;
    std::array<std::uint8_t, kPieceSize> chunk; // NOLINT: filled by the call below
    for (int count = 0; count < kMostChunks; ++count) {
        const Transfer transfer = receiveFrom(socket, chunk);
        if (transfer.state == Transfer::State::WouldBlock) {
            return true;
        }
        if (transfer.state == Transfer::State::Closed) {
            return peerEnded();
        }
        Bytes unread = Bytes(chunk).first(transfer.count);
        while (!unread.empty()) {
            unread = unread.subspan(parser.feed(unread));
            auto frame = parser.take();
            if (!parser.fault().empty() || (frame && !takeFrame(std::move(*frame)))) {
                return peerEnded();
            }
        }
    }
    return true;
}

/// False for a frame that the peer may not send.
bool SocketRemotePort::State::takeFrame(PortFrame frame) {
    const FrameKind kind = frame.header.kind;
    if (kind != FrameKind::Reply && kind != FrameKind::NoReply) {
        return false;
    }
    if (frame.header.number == requestNumber) {
        reply = std::move(frame);
    }
    return true;
}

/// Always false, as the caller's result.
bool SocketRemotePort::State::peerEnded() {
    watch.reset();
    socket.reset();
    queue.async([weak = weak_from_this()] {
        const auto state = weak.lock();
        if (state != nullptr && state->port != nullptr) {
            if (const auto callback = std::exchange(state->invalidated, {})) {
                callback(*state->port);
            }
        }
    });
    return false;
}

/// One attempt to send the rest of an earlier frame; false if the connection has ended.
bool SocketRemotePort::State::sendRest() {
    const Transfer transfer = sendTo(socket, unsent);
    if (transfer.state == Transfer::State::Closed) {
        return peerEnded();
    }
    unsent.erase(unsent.begin(), unsent.begin() + static_cast<std::ptrdiff_t>(transfer.count));
    return true;
}

SendError SocketRemotePort::State::send(Bytes header, Bytes data, SteadyTime deadline) {
    const std::size_t size = header.size() + data.size();
    std::size_t sent = 0;
    while (sent < size) {
        // Read replies in the meantime: a peer blocked on sending one would not read.
        if (!receive()) {
            return SendError::InvalidPort;
        }
        Transfer transfer;
        if (!unsent.empty()) {
            if (!sendRest()) {
                return SendError::InvalidPort;
            }
        } else {
            const Bytes restOfHeader = header.subspan(std::min(sent, header.size()));
            const std::size_t dataSent = sent - (header.size() - restOfHeader.size());
            transfer = sendTo(socket, restOfHeader, data.subspan(dataSent));
            if (transfer.state == Transfer::State::Closed) {
                (void)peerEnded();
                return SendError::InvalidPort;
            }
            sent += transfer.count;
        }
        if (sent < size && !waitFor(socket, Direction::Both, deadline)) {
            break;
        }
    }
    if (sent > 0 && sent < size) {
        const Bytes restOfHeader = header.subspan(std::min(sent, header.size()));
        const Bytes restOfData = data.subspan(sent - (header.size() - restOfHeader.size()));
        unsent.assign(restOfHeader.begin(), restOfHeader.end());
        unsent.insert(unsent.end(), restOfData.begin(), restOfData.end());
    }
    return sent < size ? SendError::SendTimedOut : SendError::None;
}

RemoteMessagePort::Outcome SocketRemotePort::State::awaitReply(SteadyTime deadline) {
    while (!reply) {
        const bool ready = waitFor(socket, Direction::Read, deadline);
        if (!receive()) {
            break;
        }
        if (!ready && !reply) {
            return {SendError::ReplyTimedOut, std::nullopt};
        }
    }
    if (!reply) {
        return {SendError::InvalidPort, std::nullopt};
    }
    const PortFrame answer = *std::exchange(reply, std::nullopt);
    if (answer.header.kind == FrameKind::NoReply) {
        return {};
    }
    return {SendError::None, answer.data};
}

SocketRemotePort::SocketRemotePort(AsioMainQueue& queue, Descriptor socket)
    : _state(std::make_shared<State>(queue, std::move(socket))) {
    _state->port = this;
    _state->watchPeer();
}

SocketRemotePort::~SocketRemotePort() {
    _state->port = nullptr;
}

void SocketRemotePort::setInvalidationCallback(InvalidationCallback callback) {
    _state->invalidated = std::move(callback);
}

bool SocketRemotePort::isValid() const {
    return static_cast<bool>(_state->socket);
}

void SocketRemotePort::invalidate() {
    if (!isValid()) {
        return;
    }
    _state->watch.reset();
    _state->socket.reset();
    if (const auto invalidated = std::exchange(_state->invalidated, {})) {
        invalidated(*this);
    }
}

RemoteMessagePort::Outcome SocketRemotePort::sendRequest(const Request& request) {
    if (request.data.size() > kLargestMessage) {
        return {SendError::TooLarge, std::nullopt};
    }
    State& state = *_state;
    if (!isValid()) {
        return {SendError::InvalidPort, std::nullopt};
    }
    FrameHeader header;
    header.kind = request.awaitReply ? FrameKind::Request : FrameKind::Message;
    header.identifier = request.identifier;
    header.number = request.awaitReply ? ++state.requestNumber : 0;
    state.reply.reset();
    const auto bytes = encodeHeader(header, request.data.size());
    const SendError error = state.send(bytes, request.data, deadlineIn(request.sendTimeout));
    if (error != SendError::None || !request.awaitReply) {
        return {error, std::nullopt};
    }
    return state.awaitReply(deadlineIn(request.replyTimeout));
}

} // namespace pallax
