#include "host/SocketLocalPort.h"

#include "host/AsioMainQueue.h"
#include "host/FileIdentity.h"
#include "host/PortFrame.h"
#include "host/SourceTimeListener.h"
#include "host/UnixSocket.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <chrono>
#include <list>
#include <sys/stat.h>

namespace pallax {

namespace {

constexpr std::size_t kChunkSize = std::size_t{64} << 10U;
/// The delay before the next try after descriptors or memory have run out.
constexpr std::chrono::milliseconds kAcceptRetryDelay{100};
/// A stream that brings more frames in a pause is read without pauses: the socket would be full.
constexpr std::size_t kFewFrames = 64;

} // namespace

/// The part that outlives the port while one of its blocks runs.
struct SocketLocalPort::State : std::enable_shared_from_this<State> {
    /// Which file the path itself is, so that only our own is removed.
    static FileIdentity fileAt(const std::string& path) {
        struct stat status {};
        return ::lstat(path.c_str(), &status) == 0 ? identityOf(status) : FileIdentity{};
    }

    explicit State(Setup from)
        : setup(std::move(from)), identity(fileAt(setup.path)),
          arrivals(setup.queue, setup.listener.number()) {}

    void waitForConnections() {
        arrivals.onceReadable([this] { acceptAll(); });
    }
    void acceptAll();
    void remove(const Session* session);
    /// Ends every connection and removes the socket's file if it is still ours. No lock is needed:
    /// the listener lives until the state ends, so no one can take over the name.
    void close();

    Setup setup;
    FileIdentity identity;
    MainQueue* dispatch = nullptr;
    std::list<std::shared_ptr<Session>> sessions;
    DescriptorWatch arrivals; // declared after the listener that it watches
};

/// One connection to the port: reads a chunk, delivers its frames one per block, reads the next.
class SocketLocalPort::Session : public std::enable_shared_from_this<Session> {
public:
    Session(const std::shared_ptr<State>& port, Descriptor socket)
        : _port(port), _socket(std::move(socket)),
          _watch(std::in_place, port->setup.queue, _socket.number()) {}

    void start() { stepLater(); }

private:
    void stepLater();
    void step();
    bool readChunk(State& port);
    void awaitMore(const State& port);
    void handle(const std::shared_ptr<State>& port);
    void tellRemark(SourceTimeListener* times, const PortFrame& frame);
    void deliver(const std::shared_ptr<State>& port, const PortFrame& frame);
    void answer(const PortFrame& request, const std::optional<ByteBuffer>& reply);
    void flush();
    void cutOff();

    std::weak_ptr<State> _port;
    Descriptor _socket;
    std::optional<DescriptorWatch> _watch; // declared after the socket that it watches
    PortFrameParser _parser;
    std::optional<PortFrame> _frame; // complete, not yet delivered
    std::array<std::uint8_t, kChunkSize> _chunk{};
    Bytes _unread; // the part of _chunk not yet parsed
    ByteBuffer _answer;
    std::size_t _answered = 0; // bytes of _answer already sent
    bool _tellsTime = false;
    std::size_t _frames = 0; // since the data last ran out
};

void SocketLocalPort::State::acceptAll() {
    const auto self = shared_from_this();
    while (Descriptor socket = acceptFrom(setup.listener)) {
        sessions.push_back(std::make_shared<Session>(self, std::move(socket)));
        sessions.back()->start();
    }
    if (errno == EAGAIN || errno == EWOULDBLOCK) {
        waitForConnections();
        return;
    }
    setup.queue.after(kAcceptRetryDelay, [weak = weak_from_this()] {
        if (const auto state = weak.lock()) {
            state->acceptAll();
        }
    });
}

void SocketLocalPort::State::remove(const Session* session) {
    sessions.remove_if([session](const auto& each) { return each.get() == session; });
}

void SocketLocalPort::State::close() {
    sessions.clear();
    if (fileAt(setup.path) == identity) {
        (void)::unlink(setup.path.c_str());
    }
}

void SocketLocalPort::Session::stepLater() {
    if (const auto port = _port.lock()) {
        port->dispatch->async([weak = weak_from_this()] {
            if (const auto self = weak.lock()) {
                self->step();
            }
        });
    }
}

void SocketLocalPort::Session::step() {
    const auto port = _port.lock();
    if (!port) {
        return;
    }
    while (!_frame) {
        if (_unread.empty() && !readChunk(*port)) {
            return;
        }
        _unread = _unread.subspan(_parser.feed(_unread));
        if (!_parser.fault().empty()) {
            cutOff();
            return;
        }
        _frame = _parser.take();
    }
    handle(port);
}

/// False if there is no data now, or the connection has ended.
bool SocketLocalPort::Session::readChunk(State& port) {
    const Transfer transfer = receiveFrom(_socket, _chunk);
    if (transfer.state == Transfer::State::WouldBlock) {
        awaitMore(port);
        return false;
    }
    if (transfer.state == Transfer::State::Closed) {
        port.remove(this);
        return false;
    }
    _unread = Bytes(_chunk).first(transfer.count);
    return true;
}

/// In a pause, there is no watch: it would wake up for each frame.
void SocketLocalPort::Session::awaitMore(const State& port) {
    const bool isPausing = port.setup.pause > std::chrono::milliseconds(0) && _frames < kFewFrames;
    _frames = 0;
    if (!isPausing) {
        return _watch->onceReadable([this] { stepLater(); });
    }
    _watch.reset();
    port.setup.queue.after(port.setup.pause, [weak = weak_from_this()] {
        const auto self = weak.lock();
        const auto open = self ? self->_port.lock() : nullptr;
        if (open) {
            self->_watch.emplace(open->setup.queue, self->_socket.number());
            self->_watch->onceReadable([session = self.get()] { session->stepLater(); });
        }
    });
}

void SocketLocalPort::Session::handle(const std::shared_ptr<State>& port) {
    SourceTimeListener* times = port->setup.times;
    if (times != nullptr && _frame->header.sourceTime) {
        if (!_tellsTime) {
            _tellsTime = true;
            times->sourceBegan(_frame->header.isLive);
        }
        if (times->advance(*_frame->header.sourceTime)) {
            stepLater(); // the frame waits until the ticks' blocks have run
            return;
        }
    }
    const PortFrame frame = std::move(*_frame);
    _frame.reset();
    ++_frames;
    switch (frame.header.kind) {
    case FrameKind::Message:
        if (times != nullptr) {
            times->packetNumber(frame.header.number);
        }
        deliver(port, frame);
        return;
    case FrameKind::Request:
        deliver(port, frame);
        return;
    case FrameKind::End:
        stepLater();
        if (times != nullptr) {
            times->sourceEnded();
        }
        return;
    case FrameKind::Clock:
        stepLater();
        return;
    case FrameKind::Remark:
        tellRemark(times, frame);
        return;
    case FrameKind::Reply:
    case FrameKind::NoReply:
        break;
    }
    cutOff(); // there was no request
}

void SocketLocalPort::Session::tellRemark(SourceTimeListener* times, const PortFrame& frame) {
    const auto remark = decodeRemark(frame.data);
    if (!remark) {
        cutOff();
        return;
    }
    stepLater();
    if (times != nullptr) {
        times->stampRemark(frame.header.number, *remark);
    }
}

/// After the callback, touches only what it has kept alive: the callback may destroy the port, or
/// throw.
void SocketLocalPort::Session::deliver(const std::shared_ptr<State>& port, const PortFrame& frame) {
    const auto self = shared_from_this();
    const auto& receive = port->setup.receive;
    if (frame.header.kind == FrameKind::Message) {
        stepLater();
        (void)receive(frame.header.identifier, frame.data);
        return;
    }
    std::optional<ByteBuffer> reply;
    try {
        reply = receive(frame.header.identifier, frame.data);
    } catch (...) {
        answer(frame, std::nullopt);
        throw;
    }
    answer(frame, reply);
}

void SocketLocalPort::Session::answer(const PortFrame& request,
                                      const std::optional<ByteBuffer>& reply) {
    const bool fits = reply && reply->size() <= kLargestMessage;
    FrameHeader header;
    header.kind = fits ? FrameKind::Reply : FrameKind::NoReply;
    header.identifier = request.header.identifier;
    header.number = request.header.number;
    _answer.clear();
    _answered = 0;
    appendFrame(_answer, header, fits ? Bytes(*reply) : Bytes());
    flush();
}

void SocketLocalPort::Session::flush() {
    while (_answered < _answer.size()) {
        const Transfer transfer = sendTo(_socket, Bytes(_answer).subspan(_answered));
        if (transfer.state == Transfer::State::Closed) {
            cutOff();
            return;
        }
        if (transfer.state == Transfer::State::WouldBlock) {
            _watch->onceWritable([this] { flush(); });
            return;
        }
        _answered += transfer.count;
    }
    _answer = ByteBuffer();
    stepLater();
}

void SocketLocalPort::Session::cutOff() {
    if (const auto port = _port.lock()) {
        port->remove(this);
    }
}

SocketLocalPort::SocketLocalPort(Setup setup) : _state(std::make_shared<State>(std::move(setup))) {}

SocketLocalPort::~SocketLocalPort() {
    close();
}

void SocketLocalPort::setInvalidationCallback(InvalidationCallback callback) {
    _invalidated = std::move(callback);
}

void SocketLocalPort::setDispatchQueue(MainQueue& queue) {
    if (_state == nullptr) {
        return;
    }
    const bool first = _state->dispatch == nullptr;
    _state->dispatch = &queue;
    if (first) {
        _state->waitForConnections();
    }
}

void SocketLocalPort::invalidate() {
    if (_state == nullptr) {
        return;
    }
    close();
    if (const auto invalidated = std::exchange(_invalidated, {})) {
        invalidated(*this);
    }
}

void SocketLocalPort::close() {
    if (_state != nullptr) {
        _state->close();
        _state.reset();
    }
}

} // namespace pallax
