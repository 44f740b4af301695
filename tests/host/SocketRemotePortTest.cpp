#include "host/PortFrame.h"
#include "tests/doubles/PortPair.h"

#include <atomic>
#include <optional>
#include <thread>

namespace pallax {
namespace {

using doubles::openDirectory;
using doubles::OtherProcess;
using doubles::PortTest;
using doubles::runUntil;
using namespace std::chrono_literals;

/// The local port runs on its own queue, as in another process.
class SocketRemotePortTest : public PortTest {
protected:
    void serve(MessagePorts::ReceiveCallback receive) {
        auto local = _serverPorts.createLocal("a.port", std::move(receive));
        ASSERT_NE(local.port, nullptr);
        _local = std::move(local.port);
        _local->setDispatchQueue(_server.queue);
        _remote = _ports.createRemote("a.port");
        ASSERT_NE(_remote, nullptr);
    }
    void TearDown() override {
        _server.end();
        _local.reset();
    }
    RemoteMessagePort::Outcome ask(std::string_view text, std::chrono::nanoseconds replyTimeout) {
        const ByteBuffer data = bytesOf(text);
        return _remote->sendRequest({0, data, 1s, replyTimeout, true});
    }

    OtherProcess _server;
    SocketMessagePorts _serverPorts{_server.queue, openDirectory()};
    std::unique_ptr<LocalMessagePort> _local;
    std::unique_ptr<RemoteMessagePort> _remote;
};

std::optional<ByteBuffer> echo(std::int32_t /*identifier*/, Bytes data) {
    return ByteBuffer(data.begin(), data.end());
}

TEST_F(SocketRemotePortTest, ANameWithoutAListenerGivesNoPort) {
    EXPECT_EQ(_ports.createRemote("nobody"), nullptr);
    EXPECT_EQ(_ports.createRemote(std::string(200, 'a')), nullptr);
}

TEST_F(SocketRemotePortTest, ARequestIsAnswered) {
    serve(echo);
    for (const char* text : {"one", "", "three"}) {
        const auto outcome = ask(text, 5s);
        EXPECT_EQ(outcome.error, SendError::None);
        EXPECT_EQ(outcome.reply, bytesOf(text));
    }
}

TEST_F(SocketRemotePortTest, AReceiverWithNothingToAnswerIsNoError) {
    serve([](std::int32_t, Bytes) { return std::nullopt; });
    const auto outcome = ask("one", 5s);
    EXPECT_EQ(outcome.error, SendError::None);
    EXPECT_EQ(outcome.reply, std::nullopt);
}

TEST_F(SocketRemotePortTest, WithoutAwaitReplyNoReplyComes) {
    std::atomic<int> calls = 0;
    serve([&](std::int32_t, Bytes) {
        ++calls;
        return ByteBuffer{1};
    });
    const auto outcome = _remote->sendRequest({3, {}, 1s, 5s, false});
    EXPECT_EQ(outcome.error, SendError::None);
    EXPECT_EQ(outcome.reply, std::nullopt);
    EXPECT_EQ(ask("next", 5s).reply, ByteBuffer{1}); // a later request works
    EXPECT_EQ(calls, 2);
}

TEST_F(SocketRemotePortTest, AMissingReplyTimesOut) {
    const auto path = socketPath("silent");
    const Descriptor listener = listenAt(path);
    const auto remote = _ports.createRemote("silent");
    const auto start = std::chrono::steady_clock::now();
    const auto outcome = remote->sendRequest({0, {}, 1s, 30ms, true});
    EXPECT_EQ(outcome.error, SendError::ReplyTimedOut);
    EXPECT_EQ(outcome.reply, std::nullopt);
    EXPECT_GE(std::chrono::steady_clock::now() - start, 30ms);
    EXPECT_TRUE(remote->isValid());
}

TEST_F(SocketRemotePortTest, ALateReplyIsNotTakenForThatOfTheNextRequest) {
    std::atomic<bool> slow = true;
    serve([&](std::int32_t, Bytes data) {
        while (slow) {
            std::this_thread::yield();
        }
        return echo(0, data);
    });
    EXPECT_EQ(ask("late", 10ms).error, SendError::ReplyTimedOut);
    slow = false;
    EXPECT_EQ(ask("next", 5s).reply, bytesOf("next"));
}

TEST_F(SocketRemotePortTest, AReceiverThatTakesNothingTimesTheSendOut) {
    const Descriptor listener = listenAt(socketPath("stuck"));
    const auto remote = _ports.createRemote("stuck");
    const ByteBuffer large(std::size_t{4} << 20U);
    EXPECT_EQ(remote->sendRequest({0, large, 30ms, 0s, false}).error, SendError::SendTimedOut);
    EXPECT_TRUE(remote->isValid());
    EXPECT_EQ(remote->sendRequest({0, large, 30ms, 0s, false}).error, SendError::SendTimedOut);
}

TEST_F(SocketRemotePortTest, AfterATimedOutSendTheFramesStayWhole) {
    const Descriptor listener = listenAt(socketPath("slow"));
    const auto remote = _ports.createRemote("slow");
    const ByteBuffer large(std::size_t{4} << 20U, 0xAB);
    ASSERT_EQ(remote->sendRequest({1, large, 10ms, 0s, false}).error, SendError::SendTimedOut);
    const Descriptor accepted = acceptFrom(listener);
    std::thread reader;
    std::vector<std::pair<std::int32_t, std::size_t>> frames;
    reader = std::thread([&] {
        PortFrameParser parser;
        std::array<std::uint8_t, 4096> buffer{};
        while (frames.size() < 2 && parser.fault().empty()) {
            const Transfer transfer = receiveFrom(accepted, buffer);
            Bytes bytes = Bytes(buffer).first(transfer.count);
            while (!bytes.empty() && parser.fault().empty()) {
                bytes = bytes.subspan(parser.feed(bytes));
                if (const auto frame = parser.take()) {
                    frames.emplace_back(frame->header.identifier, frame->data.size());
                }
            }
        }
    });
    EXPECT_EQ(remote->sendRequest({2, bytesOf("x"), 10s, 0s, false}).error, SendError::None);
    reader.join();
    EXPECT_EQ(frames,
              (std::vector<std::pair<std::int32_t, std::size_t>>{{1, large.size()}, {2, 1}}));
}

TEST_F(SocketRemotePortTest, SixteenMebibytesPassAndOneByteMoreIsRefused) {
    serve([](std::int32_t, Bytes data) { return bytesOf(std::to_string(data.size())); });
    ByteBuffer data(kLargestMessage);
    EXPECT_EQ(_remote->sendRequest({0, data, 10s, 10s, true}).reply, bytesOf("16777216"));
    data.push_back(0);
    EXPECT_EQ(_remote->sendRequest({0, data, 10s, 10s, true}).error, SendError::TooLarge);
    EXPECT_TRUE(_remote->isValid());
    EXPECT_EQ(ask("next", 5s).reply, bytesOf("4"));
}

TEST_F(SocketRemotePortTest, ALargeReplyPassesAndATooLargeOneIsNone) {
    serve([](std::int32_t identifier, Bytes) {
        return ByteBuffer(kLargestMessage + (identifier == 0 ? 0 : 1));
    });
    EXPECT_EQ(_remote->sendRequest({0, {}, 1s, 10s, true}).reply->size(), kLargestMessage);
    const auto outcome = _remote->sendRequest({1, {}, 1s, 10s, true});
    EXPECT_EQ(outcome.error, SendError::None);
    EXPECT_EQ(outcome.reply, std::nullopt);
}

TEST_F(SocketRemotePortTest, ThePeersEndInvalidatesAndCallsBackAsABlock) {
    serve(echo);
    int calls = 0;
    _remote->setInvalidationCallback([&](MessagePort& port) {
        EXPECT_EQ(&port, _remote.get());
        EXPECT_FALSE(port.isValid());
        ++calls;
    });
    _server.end();
    _local.reset();
    ASSERT_TRUE(runUntil(_queue, [&] { return calls > 0; }));
    _remote->invalidate(); // has no effect
    _queue.runReady();
    EXPECT_EQ(calls, 1);
    EXPECT_EQ(ask("too late", 5s).error, SendError::InvalidPort);
}

TEST_F(SocketRemotePortTest, ThePeersEndDuringARequestIsAnInvalidPort) {
    Descriptor listener = listenAt(socketPath("brief"));
    const auto remote = _ports.createRemote("brief");
    bool called = false;
    remote->setInvalidationCallback([&](MessagePort&) { called = true; });
    std::thread peer([&] {
        const Descriptor accepted = acceptFrom(listener);
        std::this_thread::sleep_for(5ms);
    });
    EXPECT_EQ(remote->sendRequest({0, {}, 1s, 10s, true}).error, SendError::InvalidPort);
    peer.join();
    EXPECT_FALSE(remote->isValid());
    EXPECT_FALSE(called); // only in a block of the queue
    _queue.runReady();
    EXPECT_TRUE(called);
}

TEST_F(SocketRemotePortTest, APeerThatSendsNoReplyFrameIsCutOff) {
    const Descriptor listener = listenAt(socketPath("wrong"));
    const auto remote = _ports.createRemote("wrong");
    const Descriptor accepted = acceptFrom(listener);
    (void)sendTo(accepted, encodeHeader({}, 0)); // a message, to a port that can only send requests
    ASSERT_TRUE(runUntil(_queue, [&] { return !remote->isValid(); }));
}

TEST_F(SocketRemotePortTest, APeerThatNeverStopsAnsweringKeepsNoDeadlineWaiting) {
    const Descriptor listener = listenAt(socketPath("flood"));
    auto remote = _ports.createRemote("flood");
    const Descriptor accepted = acceptFrom(listener);
    std::atomic<bool> ended = false;
    std::thread flood([&] {
        ByteBuffer noReplies; // to a request that was never sent
        for (int count = 0; count < 1000; ++count) {
            appendFrame(noReplies, {FrameKind::NoReply, 0, 77, std::nullopt}, {});
        }
        while (!ended) {
            (void)sendTo(accepted, noReplies);
        }
    });
    const auto begin = std::chrono::steady_clock::now();
    const auto outcome = remote->sendRequest({0, {}, 1s, 50ms, true});
    const auto taken = std::chrono::steady_clock::now() - begin;
    bool queueGoesOn = false;
    _queue.async([&] {
        queueGoesOn = true;
        _queue.stop();
    });
    _queue.run();
    EXPECT_TRUE(queueGoesOn);
    ended = true;
    remote.reset(); // removes the reader, so that no send waits
    flood.join();
    EXPECT_EQ(outcome.error, SendError::ReplyTimedOut);
    EXPECT_LT(taken, 5s);
}

TEST_F(SocketRemotePortTest, InvalidateCallsBackBeforeItReturns) {
    serve(echo);
    int calls = 0;
    _remote->setInvalidationCallback([&](MessagePort&) { ++calls; });
    _remote->invalidate();
    EXPECT_EQ(calls, 1);
    EXPECT_FALSE(_remote->isValid());
    _remote->invalidate();
    EXPECT_EQ(calls, 1);
}

TEST_F(SocketRemotePortTest, TheCallbackMayDestroyThePortAndADestroyedPortCallsNothing) {
    serve(echo);
    _remote->setInvalidationCallback([&](MessagePort&) { _remote.reset(); });
    auto other = _ports.createRemote("a.port");
    other->setInvalidationCallback([](MessagePort&) { FAIL(); });
    other.reset();
    _server.end();
    _local.reset();
    EXPECT_TRUE(runUntil(_queue, [&] { return _remote == nullptr; }));
}

} // namespace
} // namespace pallax
