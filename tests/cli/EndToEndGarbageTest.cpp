#include "host/PortFrame.h"
#include "host/UnixSocket.h"
#include "tests/cli/EndToEnd.h"

#include <algorithm>
#include <csignal>
#include <poll.h>
#include <random>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;

/// A real service, a real viewer, and a peer that sends arbitrary bytes to their ports.
class EndToEndGarbage : public EndToEnd {
protected:
    static constexpr const char* kViewerPort = "com.norvane.BasebandStateReport.LogChannel";
    static constexpr const char* kControlPort = "com.norvane.telephony";
    static constexpr const char* kChannelPort = "com.norvane.telephony.LogChannel.1";

    EndToEndGarbage() {
        std::vector<Packet> packets;
        for (int count = 0; count < 100; ++count) {
            packets.emplace_back(milliseconds(100) * count, registration(2));
        }
        const std::string recording = record("a.pcap", packets);
        service.emplace(world, std::vector<std::string>{"service", "--play", recording, "--loop",
                                                        "--speed", "20"});
        EXPECT_TRUE(eventually([this] { return !world.sockets().empty(); }));
        viewer.emplace(world, std::vector<std::string>{"--print"});
        EXPECT_TRUE(viewer->says("REG_STATE_REGISTERING"));
    }
    ~EndToEndGarbage() override {
        EXPECT_TRUE(goesOn()) << viewer->err();
        for (auto* process : {&*viewer, &*service}) {
            process->signal(SIGTERM);
            EXPECT_EQ(process->wait(), 0);
            EXPECT_EQ(process->err(), "");
        }
        EXPECT_TRUE(eventually([this] { return world.sockets().empty(); }));
    }

    Descriptor connectToPort(const std::string& name) const {
        Descriptor socket = connectTo(world.path("pallax/" + name));
        EXPECT_TRUE(socket) << name;
        return socket;
    }
    /// Sends all bytes unless the other side closes the connection.
    static void send(const Descriptor& socket, Bytes bytes) {
        constexpr int kMostMilliseconds = 5000;
        while (!bytes.empty()) {
            const Transfer sent = sendTo(socket, bytes);
            if (sent.state == Transfer::State::Closed) {
                return;
            }
            bytes = bytes.subspan(sent.count);
            pollfd entry{socket.number(), POLLOUT, 0};
            if (!bytes.empty() && ::poll(&entry, 1, kMostMilliseconds) <= 0) {
                return;
            }
        }
    }
    static bool isCutOff(const Descriptor& socket) {
        std::array<std::uint8_t, 1024> answer{};
        return eventually(
            [&] { return receiveFrom(socket, answer).state == Transfer::State::Closed; });
    }
    /// Whether new ticks are printed and the service reports this viewer as its only client.
    bool goesOn() const {
        const std::size_t shown = viewer->out().size();
        return eventually([&] { return viewer->out().size() > shown; }) && eventually([&] {
                   return run({"service", "--status"}).out.find("\nClients: 1\n") !=
                          std::string::npos;
               });
    }
    static ByteBuffer frames(FrameKind kind, std::size_t size, int count) {
        FrameHeader header;
        header.kind = kind;
        ByteBuffer bytes;
        const ByteBuffer data(size, 'x');
        for (int index = 0; index < count; ++index) {
            appendFrame(bytes, header, data);
        }
        return bytes;
    }

    std::optional<PallaxProcess> service;
    std::optional<PallaxProcess> viewer;
};

TEST_F(EndToEndGarbage, APeerThatSendsNoFramesIsCutOff) {
    std::mt19937 random(8); // the same bytes in every run
    for (const char* port : {kViewerPort, kControlPort, kChannelPort}) {
        for (int round = 0; round < 20; ++round) {
            const Descriptor peer = connectToPort(port);
            ByteBuffer garbage(1 + random() % 100'000);
            std::generate(garbage.begin(), garbage.end(),
                          [&] { return static_cast<std::uint8_t>(random()); });
            send(peer, garbage);
            if (garbage.size() >= kFrameHeaderSize) {
                EXPECT_TRUE(isCutOff(peer)) << port;
            }
        }
    }
    EXPECT_TRUE(goesOn());
}

TEST_F(EndToEndGarbage, AMessageThatClaimsToBeTooLargeIsCutOffAndOneThatNeverComesCostsNothing) {
    for (const char* port : {kViewerPort, kControlPort, kChannelPort}) {
        const Descriptor peer = connectToPort(port);
        send(peer, encodeHeader({}, kLargestMessage + 1));
        EXPECT_TRUE(isCutOff(peer)) << port;
    }
    std::vector<Descriptor> waiting;
    for (const char* port : {kViewerPort, kControlPort, kChannelPort}) {
        waiting.push_back(connectToPort(port));
        send(waiting.back(), encodeHeader({}, kLargestMessage));
    }
    EXPECT_TRUE(goesOn());
}

TEST_F(EndToEndGarbage, MessagesWithoutABodyAreNoRequestAndNoPacket) {
    for (const char* port : {kViewerPort, kControlPort, kChannelPort}) {
        const Descriptor peer = connectToPort(port);
        send(peer, frames(FrameKind::Message, 0, 10));
        send(peer, frames(FrameKind::Request, 0, 1));
        std::array<std::uint8_t, kFrameHeaderSize> answer{};
        EXPECT_TRUE(eventually([&] {
            return receiveFrom(peer, answer).state == Transfer::State::Moved;
        })) << port
            << ": a request gets an answer, possibly an empty one";
    }
    EXPECT_TRUE(goesOn());
}

TEST_F(EndToEndGarbage, TheLargestMessageIsNoRequestAndNoPacket) {
    for (const char* port : {kViewerPort, kControlPort, kChannelPort}) {
        const Descriptor peer = connectToPort(port);
        send(peer, frames(FrameKind::Message, kLargestMessage, 1));
    }
    EXPECT_TRUE(goesOn());
}

TEST_F(EndToEndGarbage, AFloodOfMessagesKeepsNobodyElseWaiting) {
    constexpr int kMessages = 20'000;
    std::vector<Descriptor> peers;
    const ByteBuffer flood = frames(FrameKind::Message, 10, kMessages);
    for (const char* port : {kViewerPort, kControlPort, kChannelPort}) {
        peers.push_back(connectToPort(port));
        send(peers.back(), flood);
        EXPECT_TRUE(goesOn()) << port;
    }
}

TEST_F(EndToEndGarbage, AFloodOfConnectionsIsTakenAndForgotten) {
    constexpr int kConnections = 200; // more than a socket's backlog
    for (const char* port : {kViewerPort, kControlPort, kChannelPort}) {
        std::vector<Descriptor> peers;
        for (int count = 0; count < kConnections; ++count) {
            Descriptor peer;
            ASSERT_TRUE(eventually([&] {
                peer = connectTo(world.path(std::string("pallax/") + port));
                return static_cast<bool>(peer);
            })) << port;
            peers.push_back(std::move(peer));
        }
        EXPECT_TRUE(goesOn()) << port;
    }
}

} // namespace
} // namespace pallax
