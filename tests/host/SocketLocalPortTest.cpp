#include "host/PortFrame.h"
#include "host/SourceTimeListener.h"
#include "tests/doubles/PortPair.h"

#include <algorithm>
#include <stdexcept>
#include <sys/fsuid.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <sys/wait.h>

namespace pallax {
namespace {

using doubles::openDirectory;
using doubles::PortTest;
using doubles::runUntil;
using namespace std::chrono_literals;

class SocketLocalPortTest : public PortTest {
protected:
    MessagePorts::ReceiveCallback collect() {
        return [this](std::int32_t identifier, Bytes data) -> std::optional<ByteBuffer> {
            _received.emplace_back(identifier, std::string(data.begin(), data.end()));
            return std::nullopt;
        };
    }
    std::unique_ptr<LocalMessagePort> open(std::string_view name,
                                           MessagePorts::ReceiveCallback receive) {
        auto local = _ports.createLocal(name, std::move(receive));
        EXPECT_NE(local.port, nullptr);
        EXPECT_FALSE(local.alreadyExisted);
        local.port->setDispatchQueue(_queue);
        return std::move(local.port);
    }
    static SendError post(RemoteMessagePort& port, std::int32_t identifier, std::string_view text) {
        const ByteBuffer data = bytesOf(text);
        return port.sendRequest({identifier, data, 1s, 0s, false}).error;
    }
    /// True after the peer has closed the raw connection.
    bool isCutOff(const Descriptor& socket) {
        return runUntil(_queue, [&] {
            std::array<std::uint8_t, 64> buffer{};
            return receiveFrom(socket, buffer).state == Transfer::State::Closed;
        });
    }

    using Received = std::vector<std::pair<std::int32_t, std::string>>;
    Received _received;
};

TEST_F(SocketLocalPortTest, DeliversMessagesInOrder) {
    const auto local = open("a.port", collect());
    const auto remote = _ports.createRemote("a.port");
    ASSERT_NE(remote, nullptr);
    EXPECT_EQ(post(*remote, 0, "one"), SendError::None);
    EXPECT_EQ(post(*remote, -7, ""), SendError::None);
    EXPECT_EQ(post(*remote, 0, "three"), SendError::None);
    ASSERT_TRUE(runUntil(_queue, [&] { return _received.size() == 3; }));
    EXPECT_EQ(_received, (Received{{0, "one"}, {-7, ""}, {0, "three"}}));
}

TEST_F(SocketLocalPortTest, FramesThatComeSlowlyAreTakenTogetherAfterAPause) {
    _ports.setPause(200ms);
    const auto local = open("a.port", collect());
    const auto remote = _ports.createRemote("a.port");
    ASSERT_NE(remote, nullptr);
    EXPECT_EQ(post(*remote, 0, "one"), SendError::None);
    ASSERT_TRUE(runUntil(_queue, [&] { return _received.size() == 1; }));
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_EQ(post(*remote, 0, "two"), SendError::None);
    ASSERT_TRUE(runUntil(_queue, [&] { return _received.size() == 2; }));
    EXPECT_GE(std::chrono::steady_clock::now() - begin, 150ms);
}

TEST_F(SocketLocalPortTest, AStreamWithManyFramesIsReadWithoutPauses) {
    constexpr std::size_t kMany = 64;
    _ports.setPause(1h);
    const auto local = open("a.port", collect());
    const auto remote = _ports.createRemote("a.port");
    ASSERT_NE(remote, nullptr);
    for (std::size_t frame = 0; frame < kMany; ++frame) {
        EXPECT_EQ(post(*remote, 0, "frame"), SendError::None);
    }
    ASSERT_TRUE(runUntil(_queue, [&] { return _received.size() == kMany; }));
    EXPECT_EQ(post(*remote, 0, "next"), SendError::None);
    EXPECT_TRUE(runUntil(_queue, [&] { return _received.size() == kMany + 1; }));
}

TEST_F(SocketLocalPortTest, TheSocketIsItsUsersAlone) {
    const auto local = open("a.port", collect());
    struct stat status {};
    ASSERT_EQ(::stat(socketPath("a.port").c_str(), &status), 0);
    EXPECT_TRUE(S_ISSOCK(status.st_mode));
    EXPECT_EQ(status.st_mode & 07777U, 0600U);
}

TEST_F(SocketLocalPortTest, BeforeItHasAQueueNothingIsDelivered) {
    auto local = _ports.createLocal("a.port", collect());
    const auto remote = _ports.createRemote("a.port");
    ASSERT_NE(remote, nullptr);
    EXPECT_EQ(post(*remote, 0, "early"), SendError::None);
    _queue.runReady();
    EXPECT_EQ(_received, Received{});
    local.port->setDispatchQueue(_queue);
    ASSERT_TRUE(runUntil(_queue, [&] { return !_received.empty(); }));
}

TEST_F(SocketLocalPortTest, SeveralPeersMayBeConnected) {
    const auto local = open("a.port", collect());
    const auto first = _ports.createRemote("a.port");
    const auto second = _ports.createRemote("a.port");
    EXPECT_EQ(post(*first, 1, "x"), SendError::None);
    EXPECT_EQ(post(*second, 2, "y"), SendError::None);
    ASSERT_TRUE(runUntil(_queue, [&] { return _received.size() == 2; }));
    EXPECT_EQ(_received.front().second.size() + _received.back().second.size(), 2U);
}

TEST_F(SocketLocalPortTest, ANameInUseIsToldAndTheNewPortIsInert) {
    const auto local = open("a.port", collect());
    auto second = _ports.createLocal("a.port", collect());
    EXPECT_TRUE(second.alreadyExisted);
    ASSERT_NE(second.port, nullptr);
    EXPECT_FALSE(second.port->isValid());
    bool called = false;
    second.port->setInvalidationCallback([&](MessagePort&) { called = true; });
    second.port->setDispatchQueue(_queue);
    second.port->invalidate();
    EXPECT_FALSE(called);
    second.port.reset();
    EXPECT_NE(_ports.createRemote("a.port"), nullptr); // the living port is unaffected
}

TEST_F(SocketLocalPortTest, AStaleFileIsReplaced) {
    (void)listenAt(socketPath("a.port")); // closed at once, but the file remains
    const auto local = open("a.port", collect());
    EXPECT_TRUE(local->isValid());
    EXPECT_NE(_ports.createRemote("a.port"), nullptr);
}

TEST_F(SocketLocalPortTest, AnImpossiblePortIsNull) {
    const std::string name(200, 'a');
    EXPECT_EQ(_ports.createLocal(name, collect()).port, nullptr);
    EXPECT_EQ(_ports.lastError().find("The name of the message port " + name + " is too long"), 0U);
    ASSERT_EQ(::mkdir(socketPath("folder").c_str(), 0700), 0);
    EXPECT_EQ(_ports.createLocal("folder", collect()).port, nullptr);
    EXPECT_EQ(_ports.lastError(), "The message port folder cannot be made at " +
                                      socketPath("folder") + ": Address already in use.");
}

TEST_F(SocketLocalPortTest, InvalidateRemovesTheSocketAndCallsBackOnce) {
    const auto local = open("a.port", collect());
    std::vector<MessagePort*> calls;
    local->setInvalidationCallback([&](MessagePort& port) {
        EXPECT_FALSE(port.isValid());
        EXPECT_EQ(_folder.socketCount(), 0U);
        calls.push_back(&port);
    });
    EXPECT_EQ(_folder.socketCount(), 1U);
    local->invalidate();
    local->invalidate();
    EXPECT_EQ(calls, (std::vector<MessagePort*>{local.get()}));
}

TEST_F(SocketLocalPortTest, DestructionRemovesTheSocketWithoutACallBack) {
    auto local = open("a.port", collect());
    local->setInvalidationCallback([](MessagePort&) { FAIL(); });
    local.reset();
    EXPECT_EQ(_folder.socketCount(), 0U);
}

TEST_F(SocketLocalPortTest, AFileThatIsNoLongerItsOwnIsLeftAlone) {
    auto local = open("a.port", collect());
    ASSERT_EQ(::unlink(socketPath("a.port").c_str()), 0);
    const Descriptor other = listenAt(socketPath("a.port"));
    ASSERT_TRUE(other);
    local.reset();
    EXPECT_EQ(listenerAt(socketPath("a.port")), Listener::Living);
}

TEST_F(SocketLocalPortTest, TheInvalidationCallbackMayDestroyThePort) {
    auto local = open("a.port", collect());
    local->setInvalidationCallback([&](MessagePort&) { local.reset(); });
    local->invalidate();
    EXPECT_EQ(local, nullptr);
}

TEST_F(SocketLocalPortTest, TheReceiveCallbackMayDestroyThePort) {
    std::unique_ptr<LocalMessagePort> local;
    std::string seen; // owned by the callback, which must live until it returns
    local = open(
        "a.port",
        [&, kept = std::string(100, 'k')](std::int32_t, Bytes data) -> std::optional<ByteBuffer> {
            local.reset();
            seen = kept + std::string(data.begin(), data.end());
            return ByteBuffer{1};
        });
    const auto remote = _ports.createRemote("a.port");
    EXPECT_EQ(post(*remote, 0, "one"), SendError::None);
    EXPECT_EQ(post(*remote, 0, "two"), SendError::None);
    ASSERT_TRUE(runUntil(_queue, [&] { return !seen.empty(); }));
    _queue.runReady();
    EXPECT_EQ(seen, std::string(100, 'k') + "one");
    EXPECT_EQ(_folder.socketCount(), 0U);
}

TEST_F(SocketLocalPortTest, AfterAnExceptionOfTheCallbackTheNextMessageComes) {
    int calls = 0;
    const auto local = open("a.port", [&](std::int32_t, Bytes) -> std::optional<ByteBuffer> {
        if (++calls == 1) {
            throw std::runtime_error("a fatal record");
        }
        return std::nullopt;
    });
    const auto remote = _ports.createRemote("a.port");
    EXPECT_EQ(post(*remote, 0, "one"), SendError::None);
    EXPECT_EQ(post(*remote, 0, "two"), SendError::None);
    EXPECT_THROW((void)runUntil(_queue, [&] { return calls == 2; }), std::runtime_error);
    EXPECT_TRUE(runUntil(_queue, [&] { return calls == 2; }));
}

TEST_F(SocketLocalPortTest, APeerThatBreaksTheFramingIsCutOffAndTheOthersStay) {
    const auto local = open("a.port", collect());
    const auto remote = _ports.createRemote("a.port");
    const Descriptor raw = connectTo(socketPath("a.port"));
    ASSERT_TRUE(raw);
    (void)sendTo(raw, bytesOf("GET / HTTP/1.1 and whatever comes then"));
    EXPECT_TRUE(isCutOff(raw));
    EXPECT_EQ(post(*remote, 0, "still here"), SendError::None);
    EXPECT_TRUE(runUntil(_queue, [&] { return _received.size() == 1; }));
}

TEST_F(SocketLocalPortTest, AReplyThatNobodyAskedForCutsThePeerOff) {
    const auto local = open("a.port", collect());
    const Descriptor raw = connectTo(socketPath("a.port"));
    FrameHeader header;
    header.kind = FrameKind::Reply;
    (void)sendTo(raw, encodeHeader(header, 0));
    EXPECT_TRUE(isCutOff(raw));
}

TEST_F(SocketLocalPortTest, APeerOfAnotherUserIsRefused) {
    if (::geteuid() != 0) {
        GTEST_SKIP() << "only root can become another user";
    }
    const auto local = open("a.port", collect());
    const std::string path = socketPath("a.port");
    const pid_t child = ::fork();
    if (child == 0) {
        // The socket sees another user, who can still reach its file.
        const bool changed = ::seteuid(12345) == 0;
        (void)::setfsuid(0);
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        std::copy(path.begin(), path.end(), std::begin(address.sun_path));
        const Descriptor socket(::socket(AF_UNIX, SOCK_STREAM, 0));
        const void* generic = &address;
        const bool connected =
            ::connect(socket.number(), static_cast<const sockaddr*>(generic), sizeof address) == 0;
        std::uint8_t byte = 0;
        const bool ended = ::read(socket.number(), &byte, 1) <= 0; // closed without an answer
        ::_exit(changed && connected && ended ? 0 : 1);
    }
    int status = -1;
    EXPECT_TRUE(runUntil(_queue, [&] { return ::waitpid(child, &status, WNOHANG) == child; }));
    EXPECT_EQ(status, 0);
}

TEST_F(SocketLocalPortTest, ASlowReceiverStopsTheSenderAndNothingIsBuffered) {
    std::size_t received = 0;
    const auto local = open("a.port", [&](std::int32_t, Bytes data) -> std::optional<ByteBuffer> {
        received += data.size();
        return std::nullopt;
    });
    const Descriptor raw = connectTo(socketPath("a.port"));
    ByteBuffer stream;
    for (int count = 0; count < 1000; ++count) {
        appendFrame(stream, {}, ByteBuffer(1000));
    }
    // Each attempt to send runs in its own block, because the receiver takes little at a time.
    std::size_t sent = 0;
    std::size_t mostAhead = 0;
    const auto step = [&] {
        for (;;) {
            const Transfer transfer = sendTo(raw, Bytes(stream).subspan(sent % stream.size()));
            if (transfer.state != Transfer::State::Moved) {
                break;
            }
            sent += transfer.count;
        }
        mostAhead = std::max(mostAhead, sent - received);
        return received > std::size_t{8} << 20U;
    };
    EXPECT_TRUE(runUntil(_queue, step));
    // Two socket buffers and a chunk, which the kernel may enlarge; not megabytes.
    EXPECT_LT(mostAhead, std::size_t{1} << 20U);
}

class Diary final : public SourceTimeListener {
public:
    void sourceBegan(bool isLive) override { lines.emplace_back(isLive ? "began live" : "began"); }
    bool advance(Time time) override {
        lines.push_back("advance " + std::to_string(time.time_since_epoch().count()));
        if (steps == 0) {
            return false;
        }
        --steps;
        queue->async([this] { lines.emplace_back("posted by a tick"); });
        return true;
    }
    void packetNumber(std::uint32_t number) override { numbers.push_back(number); }
    void stampRemark(std::uint32_t packet, const StampRemark& remark) override {
        lines.push_back("remark on " + std::to_string(packet) + ": " +
                        std::to_string(remark.size.count()));
    }
    void sourceEnded() override { lines.emplace_back("ended"); }

    std::vector<std::string> lines;
    std::vector<std::uint32_t> numbers;
    int steps = 0;
    MainQueue* queue = nullptr;
};

TEST_F(SocketLocalPortTest, SourceTimesAreToldBeforeTheMessageAndTicksPrecedeIt) {
    Diary diary;
    diary.queue = &_queue;
    SocketMessagePorts ports(_queue, openDirectory(), &diary);
    auto local = ports.createLocal("a.port", [&](std::int32_t, Bytes data) {
        diary.lines.push_back("message " + std::string(data.begin(), data.end()));
        return std::nullopt;
    });
    local.port->setDispatchQueue(_queue);
    ByteBuffer stream;
    FrameHeader header;
    header.sourceTime = Time(std::chrono::nanoseconds(5));
    header.number = 17;
    appendFrame(stream, header, bytesOf("a"));
    header.sourceTime.reset();
    header.number = 0;
    appendFrame(stream, header, bytesOf("b"));
    header.kind = FrameKind::Clock;
    header.sourceTime = Time(std::chrono::nanoseconds(9));
    appendFrame(stream, header, {});
    header.kind = FrameKind::End;
    header.sourceTime.reset();
    appendFrame(stream, header, {});
    diary.steps = 1;
    const Descriptor raw = connectTo(socketPath("a.port"));
    (void)sendTo(raw, stream);
    ASSERT_TRUE(
        runUntil(_queue, [&] { return !diary.lines.empty() && diary.lines.back() == "ended"; }));
    EXPECT_EQ(diary.lines,
              (std::vector<std::string>{"began", "advance 5", "posted by a tick", "advance 5",
                                        "message a", "message b", "advance 9", "ended"}));
    EXPECT_EQ(diary.numbers, (std::vector<std::uint32_t>{17, 0}));
}

TEST_F(SocketLocalPortTest, ALiveSourceAndRemarksAreTold) {
    Diary diary;
    SocketMessagePorts ports(_queue, openDirectory(), &diary);
    auto local = ports.createLocal("a.port", [](std::int32_t, Bytes) { return std::nullopt; });
    local.port->setDispatchQueue(_queue);
    ByteBuffer stream;
    FrameHeader header;
    header.kind = FrameKind::Remark;
    header.isLive = true;
    header.number = 18;
    header.sourceTime = Time(std::chrono::nanoseconds(5));
    appendFrame(stream, header,
                encodeRemark({StampRemark::Kind::Gap, std::chrono::nanoseconds(70)}));
    const Descriptor raw = connectTo(socketPath("a.port"));
    (void)sendTo(raw, stream);
    EXPECT_TRUE(runUntil(_queue, [&] { return diary.lines.size() == 3; }));
    EXPECT_EQ(diary.lines,
              (std::vector<std::string>{"began live", "advance 5", "remark on 18: 70"}));
}

TEST_F(SocketLocalPortTest, APeerWhoseRemarkIsNoneIsCutOff) {
    SocketMessagePorts ports(_queue, openDirectory());
    auto local = ports.createLocal("a.port", [](std::int32_t, Bytes) { return std::nullopt; });
    local.port->setDispatchQueue(_queue);
    FrameHeader header;
    header.kind = FrameKind::Remark;
    ByteBuffer stream;
    appendFrame(stream, header, bytesOf("what remark?"));
    const Descriptor raw = connectTo(socketPath("a.port"));
    (void)sendTo(raw, stream);
    std::array<std::uint8_t, 1> nothing{};
    EXPECT_TRUE(runUntil(
        _queue, [&] { return receiveFrom(raw, nothing).state == Transfer::State::Closed; }));
}

} // namespace
} // namespace pallax
