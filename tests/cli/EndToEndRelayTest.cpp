#include "host/Descriptor.h"
#include "host/Recording.h"
#include "tests/cli/EndToEnd.h"
#include "tests/cli/PallaxTerminal.h"

#include <algorithm>
#include <csignal>
#include <fcntl.h>
#include <fstream>
#include <optional>
#include <sys/stat.h>
#include <thread>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using doubles::World;
using std::chrono::milliseconds;
using std::chrono::seconds;

/// `pallax service --relay -`, which the test feeds through a named pipe like a recording program.
class EndToEndRelay : public EndToEnd {
protected:
    EndToEndRelay() {
        EXPECT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
        const Descriptor both(::open(pipe.c_str(), O_RDWR | O_CLOEXEC)); // does not wait
        service.emplace(world, std::vector<std::string>{"service", "--relay", "-"}, pipe);
        auto writer = RecordingWriter::create(pipe, kGsmLinkType);
        EXPECT_TRUE(writer);
        device = std::move(writer).value();
        EXPECT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    }

    void send(seconds sinceStart, unsigned state) const {
        EXPECT_EQ(device->write(kSampleStart + sinceStart, registration(state)), std::nullopt);
    }
    void sendBytes(const std::string& bytes) const {
        std::ofstream(pipe, std::ios::binary) << bytes;
    }
    /// Waits until this many clients have started their stream.
    bool clientsStream(int count) const {
        return eventually([&] {
            const std::string status = run({"service", "--status"}).out;
            int streaming = 0;
            for (auto at = status.find(": streaming"); at != std::string::npos;
                 at = status.find(": streaming", at + 1)) {
                ++streaming;
            }
            return streaming == count;
        });
    }
    int packetsIn(const std::string& path) const {
        const auto recording = Recording::open(path);
        int count = 0;
        while (recording && (*recording)->next()) {
            ++count;
        }
        return count;
    }

    std::string pipe = world.path("device");
    std::unique_ptr<RecordingWriter> device;
    std::optional<PallaxProcess> service;
};

TEST_F(EndToEndRelay, AViewersTitleTellsThatAStreamIsSilent) {
    PallaxTerminal terminal(world, {}, {});
    ASSERT_TRUE(clientsStream(1));
    send(seconds(0), 2);
    EXPECT_TRUE(terminal.shows("Updated "));
    EXPECT_TRUE(terminal.shows("no data for 7 s"));
    send(seconds(3), 2);
    EXPECT_TRUE(terminal.showsNoMore("no data for"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndRelay, AStreamGoesToEveryClientAsItComesAndTheServiceEndsWithIt) {
    PallaxProcess viewer(world, {"--log-level", "3"});
    PallaxProcess recorder(world, {"record", world.path("a.pcapng")});
    ASSERT_TRUE(clientsStream(2));
    send(seconds(0), 2);
    send(seconds(3), 2);
    EXPECT_TRUE(viewer.says("  MM Service State: REG_STATE_REGISTERING\n"));
    send(seconds(4), 0);
    device.reset();
    EXPECT_EQ(service->wait(), 0);
    EXPECT_EQ(service->err(), "pallax: The stream has ended. 3 packets were relayed.\n");
    EXPECT_EQ(recorder.wait(), 0);
    EXPECT_EQ(packetsIn(world.path("a.pcapng")), 3);
    EXPECT_TRUE(viewer.says("* MM Service State: REG_STATE_INACTIVE\n")) << "the last tick";
    EXPECT_TRUE(viewer.says("INVALIDATED"));
    viewer.signal(SIGTERM);
    EXPECT_EQ(viewer.wait(), 0);
    EXPECT_TRUE(eventually([this] { return world.sockets().empty(); }));
}

TEST(EndToEndRelayOfARecorder, ARecorderOnADeviceFeedsAViewerElsewhere) {
    const World device;
    const World desk;
    const std::string pipe = desk.path("wire");
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    std::optional<Descriptor> both(
        ::open(pipe.c_str(), O_RDWR | O_CLOEXEC)); // so that nobody waits
    PallaxProcess modem(device,
                        {"service", "--simulate", "lte", "--seconds", "20", "--speed", "10"});
    ASSERT_TRUE(eventually([&] { return !device.sockets().empty(); }));
    PallaxProcess recorder(device, {"record", "-"}, "/dev/null", pipe);
    PallaxProcess relay(desk, {"service", "--relay", "-"}, pipe);
    both.reset();
    ASSERT_TRUE(eventually([&] { return !desk.sockets().empty(); }));
    PallaxProcess viewer(desk, {"--print"});
    EXPECT_TRUE(viewer.says("Serving Cell Measurements\n"));
    EXPECT_TRUE(viewer.says("Measured RSRP: -"));
    EXPECT_EQ(recorder.wait(), 0) << recorder.err();
    EXPECT_EQ(relay.wait(), 0);
    EXPECT_TRUE(relay.says("pallax: The stream has ended."));
    viewer.signal(SIGTERM);
    EXPECT_EQ(viewer.wait(), 0);
    modem.signal(SIGTERM);
    EXPECT_EQ(modem.wait(), 0);
}

TEST_F(EndToEndRelay, WhoComesLaterGetsWhatComesLater) {
    const std::string early = world.path("early.pcapng");
    const std::string late = world.path("late.pcapng");
    PallaxProcess first(world, {"record", early});
    ASSERT_TRUE(clientsStream(1));
    send(seconds(0), 0);
    send(seconds(1), 0);
    ASSERT_TRUE(eventually([&] { return packetsIn(early) == 2; }));
    PallaxProcess second(world, {"record", late});
    ASSERT_TRUE(clientsStream(2));
    send(seconds(2), 0);
    device.reset();
    EXPECT_EQ(first.wait(), 0);
    EXPECT_EQ(second.wait(), 0);
    EXPECT_EQ(packetsIn(early), 3);
    EXPECT_EQ(packetsIn(late), 1);
    EXPECT_EQ(service->wait(), 0);
}

TEST_F(EndToEndRelay, AStoppedClientDelaysNeitherOtherClientsNorTheEnd) {
    constexpr int kPackets = 40'000; // each takes 50 bytes or more on the wire: more than may wait
    const std::string file = world.path("living.pcapng");
    PallaxProcess stopped(world, {"record", world.path("stopped.pcapng")});
    PallaxProcess living(world, {"record", file});
    ASSERT_TRUE(clientsStream(2));
    stopped.signal(SIGSTOP);
    for (int count = 0; count < kPackets; ++count) {
        send(seconds(count), 0);
    }
    device.reset();
    EXPECT_EQ(service->wait(), 0);
    EXPECT_NE(service->err().find(" is too slow: packets are dropped.\n"), std::string::npos);
    EXPECT_NE(service->err().find("The stream has ended. 40000 packets were relayed.\n"),
              std::string::npos)
        << service->err();
    EXPECT_EQ(living.wait(), 0);
    stopped.signal(SIGCONT);
    stopped.signal(SIGTERM);
    EXPECT_EQ(stopped.wait(), 0);
    EXPECT_GT(packetsIn(file), packetsIn(world.path("stopped.pcapng")));
}

TEST_F(EndToEndRelay, AClientThatComesLateToTheEndStillHearsEverything) {
    constexpr int kPackets = 1000; // the socket has room for all
    const std::string file = world.path("a.pcapng");
    PallaxProcess recorder(world, {"record", file});
    ASSERT_TRUE(clientsStream(1));
    recorder.signal(SIGSTOP);
    for (int count = 0; count < kPackets; ++count) {
        send(seconds(count), 0);
    }
    device.reset();
    std::this_thread::sleep_for(std::chrono::milliseconds(500));
    recorder.signal(SIGCONT);
    EXPECT_EQ(recorder.wait(), 0);
    EXPECT_EQ(service->wait(), 0);
    EXPECT_EQ(packetsIn(file), kPackets);
}

TEST_F(EndToEndRelay, WhenItsStreamHasEndedTheNextServiceMayStartAtOnce) {
    PallaxProcess recorder(world, {"record", world.path("a.pcapng")});
    ASSERT_TRUE(clientsStream(1));
    recorder.signal(SIGSTOP); // the service waits for it
    send(seconds(0), 0);
    device.reset();
    ASSERT_TRUE(service->says("The stream has ended."));
    PallaxProcess next(world, {"service", "--simulate", "lte"});
    EXPECT_TRUE(eventually([&] {
        return run({"service", "--status"}).out.starts_with("Technology: Zorell_LTE\n");
    })) << next.err();
    recorder.signal(SIGCONT);
    EXPECT_EQ(recorder.wait(), 0);
    EXPECT_EQ(service->wait(), 0);
    EXPECT_EQ(packetsIn(world.path("a.pcapng")), 1);
    next.signal(SIGTERM);
    EXPECT_EQ(next.wait(), 0) << next.err();
}

TEST_F(EndToEndRelay, AStreamThatBreaksOffInAPacketIsAFailure) {
    PallaxProcess recorder(world, {"record", world.path("a.pcapng")});
    ASSERT_TRUE(clientsStream(1));
    send(seconds(0), 0);
    sendBytes(std::string(20, '\0').replace(8, 1, "\x40").replace(12, 1, "\x40"));
    device.reset();
    EXPECT_EQ(service->wait(), 1);
    EXPECT_EQ(service->err(), "pallax: standard input ends in the middle of a packet. 1 packets "
                              "were relayed.\n");
    EXPECT_EQ(recorder.wait(), 0) << "its channel was closed normally";
    EXPECT_EQ(packetsIn(world.path("a.pcapng")), 1);
}

TEST_F(EndToEndRelay, AStreamThatTurnsToGarbageIsAFailure) {
    PallaxProcess recorder(world, {"record", world.path("a.pcapng")});
    ASSERT_TRUE(clientsStream(1));
    send(seconds(0), 0);
    sendBytes(std::string(4096, '\xEE'));
    EXPECT_EQ(service->wait(), 1) << "before the writer's end";
    const std::string complaint = service->err();
    EXPECT_TRUE(complaint.starts_with("pallax: standard input cannot be read further: "))
        << complaint;
    EXPECT_TRUE(complaint.ends_with(". 1 packets were relayed.\n")) << complaint;
    EXPECT_EQ(recorder.wait(), 0);
    EXPECT_EQ(packetsIn(world.path("a.pcapng")), 1);
}

/// A stream that begins when the test starts it.
class EndToEndRelayBegins : public EndToEnd {
protected:
    EndToEndRelayBegins() {
        EXPECT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
        both = Descriptor(::open(pipe.c_str(), O_RDWR | O_CLOEXEC));
        service.emplace(world, std::vector<std::string>{"service", "--relay", "-", "--wait", "0"},
                        pipe);
    }

    std::string pipe = world.path("device");
    Descriptor both; // so that nobody waits, and the stream does not end
    std::optional<PallaxProcess> service;
};

TEST_F(EndToEndRelayBegins, AStreamWhoseHeaderDoesNotComeHasStalledAndMayGoOn) {
    const auto says = [this](const char* text) {
        return service->says(text) || service->says(text); // twice, because a stall takes 10 s
    };
    EXPECT_TRUE(says("pallax: The stream has stalled: no header for 10 s.\n"));
    EXPECT_TRUE(world.sockets().empty()) << "the technology is not known yet";
    auto writer = RecordingWriter::create(pipe, kGsmLinkType);
    ASSERT_TRUE(writer);
    auto device = std::move(writer).value();
    EXPECT_TRUE(says("pallax: The stream continues after 1"));
    EXPECT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    EXPECT_EQ(device->write(kSampleStart, registration(0)), std::nullopt);
    device.reset();
    both.reset();
    EXPECT_EQ(service->wait(), 0);
    EXPECT_TRUE(service->err().ends_with("pallax: The stream has ended. 1 packets were relayed.\n"))
        << service->err();
}

TEST_F(EndToEndRelayBegins, AStreamThatEndsBeforeItsHeaderOrIsNoneIsAFailure) {
    both.reset();
    EXPECT_EQ(service->wait(), 1);
    EXPECT_EQ(service->err(), "pallax: standard input is empty.\n");
    std::ofstream(world.path("garbage"), std::ios::binary) << std::string(4096, '\xEE');
    const Run garbage = run({"service", "--relay", "-"}, world.path("garbage"));
    EXPECT_EQ(garbage.status, 1);
    EXPECT_EQ(garbage.err,
              "pallax: standard input is not a recording: it is neither pcap nor pcapng.\n");
}

TEST_F(EndToEndRelay, TheStatusTellsWhatRuns) {
    const Run idle = run({"service", "--status"});
    EXPECT_EQ(idle.status, 0);
    EXPECT_TRUE(idle.out.starts_with("Technology: Zorell_GSM\nUptime: ")) << idle.out;
    EXPECT_TRUE(idle.out.ends_with(" s\nPackets sent: 0\nPackets dropped: 0\nClients: 0\n"))
        << idle.out;
    PallaxProcess viewer(world, {"--print"});
    ASSERT_TRUE(clientsStream(1));
    send(seconds(0), 0);
    send(seconds(1), 2);
    std::string status;
    EXPECT_TRUE(eventually([&] {
        status = run({"service", "--status"}).out;
        return status.find("Packets sent: 2\n") != std::string::npos;
    }));
    EXPECT_TRUE(status.ends_with("Packets sent: 2\nPackets dropped: 0\nClients: 1\n"
                                 "  com.norvane.BasebandStateReport.LogChannel: streaming, "
                                 "2 packets sent, 0 dropped\n"))
        << status;
    service->signal(SIGTERM);
    EXPECT_EQ(service->wait(), 0);
    const Run none = run({"service", "--status"});
    EXPECT_EQ(none.status, 1);
    EXPECT_EQ(none.out, "");
    EXPECT_EQ(none.err, "pallax: No telephony service is running.\n");
}

} // namespace
} // namespace pallax
