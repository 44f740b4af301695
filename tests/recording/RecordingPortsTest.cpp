#include "recording/RecordingPorts.h"

#include "tests/doubles/FakePorts.h"
#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

class RecordingPortsTest : public testing::Test, protected LinkListener {
protected:
    bool replied(Bytes reply) override {
        replies.emplace_back(reply.begin(), reply.end());
        return passesReplies;
    }
    void packetArrived(Bytes packet) override {
        packets.emplace_back(packet.begin(), packet.end());
    }

    using Texts = std::vector<std::string>;
    static ByteBuffer bytesOf(std::string_view text) { return {text.begin(), text.end()}; }

    bool passesReplies = true;
    Texts replies;
    Texts packets;
    doubles::SteppedQueue queue;
    doubles::FakePorts fakes;
    RecordingPorts ports{fakes, *this};
};

TEST_F(RecordingPortsTest, PacketsGoToTheListenerAndNotToTheModel) {
    int received = 0;
    const auto local = ports.createLocal("name", [&](std::int32_t, Bytes) {
        ++received;
        return std::nullopt;
    });
    local.port->setDispatchQueue(queue);
    fakes.deliver(bytesOf("one"));
    fakes.deliver({});
    fakes.deliver(bytesOf("no packet"), 1);
    queue.runReady();
    EXPECT_EQ(packets, (Texts{"one", ""}));
    EXPECT_EQ(received, 0);
    EXPECT_EQ(fakes.replies(), (std::vector<std::optional<ByteBuffer>>(3, std::nullopt)));
}

TEST_F(RecordingPortsTest, ANameInUseIsTold) {
    fakes.localExists = true;
    EXPECT_TRUE(ports.createLocal("name", {}).alreadyExisted);
}

TEST_F(RecordingPortsTest, ARemotePortThatIsNotThereIsNull) {
    fakes.failRemote = true;
    EXPECT_EQ(ports.createRemote("name"), nullptr);
}

TEST_F(RecordingPortsTest, RepliesAreOverheardAndWithheldWhereTheListenerSaysSo) {
    fakes.answer = [](const RemoteMessagePort::Request& request) {
        return request.awaitReply
                   ? RemoteMessagePort::Outcome{SendError::None, bytesOf("reply")}
                   : RemoteMessagePort::Outcome{SendError::SendTimedOut, std::nullopt};
    };
    const auto remote = ports.createRemote("name");
    RemoteMessagePort::Request request;
    request.awaitReply = true;
    EXPECT_EQ(remote->sendRequest(request).reply, bytesOf("reply"));
    passesReplies = false;
    const auto withheld = remote->sendRequest(request);
    EXPECT_EQ(withheld.error, SendError::None);
    EXPECT_EQ(withheld.reply, std::nullopt);
    EXPECT_EQ(replies, (Texts{"reply", "reply"}));
    request.awaitReply = false;
    EXPECT_EQ(remote->sendRequest(request).error, SendError::SendTimedOut);
    EXPECT_EQ(replies.size(), 2U);
    EXPECT_EQ(fakes.requests.size(), 3U);
}

TEST_F(RecordingPortsTest, TheRemotePortsEndIsTheOverheardPortsOwn) {
    const auto remote = ports.createRemote("name");
    const MessagePort* ended = nullptr;
    remote->setInvalidationCallback([&](MessagePort& port) { ended = &port; });
    EXPECT_TRUE(remote->isValid());
    fakes.endRemote();
    EXPECT_EQ(ended, remote.get());
    EXPECT_FALSE(remote->isValid());

    const auto cleared = ports.createRemote("name");
    cleared->setInvalidationCallback([](MessagePort&) { FAIL(); });
    cleared->setInvalidationCallback({});
    cleared->invalidate();
    EXPECT_FALSE(cleared->isValid());
}

} // namespace
} // namespace pallax
