#include "host/Descriptor.h"
#include "host/Recording.h"
#include "tests/cli/EndToEndScreen.h"
#include "tests/doubles/Files.h"

#include <nlohmann/json.hpp>

#include <csignal>
#include <ctime>
#include <fcntl.h>
#include <fstream>
#include <optional>
#include <sstream>
#include <sys/stat.h>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;
using std::chrono::seconds;
using Lines = std::vector<std::string>;

/// Recordings whose stamps step back or forward.
class EndToEndSteps : public EndToEnd {
protected:
    /// A record that GSM viewers do not request.
    static ByteBuffer unwanted() { return doubles::Record(0x0001).u8(0).prefixed(); }

    /// "2023-11-14 22:13:22 REG_STATE_INACTIVE" for each tick of `decode`.
    Lines decodedTicks(const std::string& recording) const {
        Lines ticks;
        std::istringstream lines(run({"decode", "--every", "tick", recording}).out);
        for (std::string line; std::getline(lines, line);) {
            const auto tick = nlohmann::json::parse(line);
            std::string time = tick["time"];
            time = time.substr(0, time.find('.'));
            time[time.find('T')] = ' ';
            const std::string state = tick["display"]["Process CO"]["MM Service State"];
            ticks.push_back(time + " " + state);
        }
        return ticks;
    }
    /// The same lines from the printed output.
    static Lines printedTicks(const std::string& text) {
        Lines ticks;
        std::istringstream lines(text);
        for (std::string line; std::getline(lines, line);) {
            constexpr std::string_view kState = " MM Service State: ";
            const auto state = line.find(kState);
            if (line.starts_with("== ")) {
                ticks.push_back(line.substr(3, line.find(" +0000") - 3) + ":");
            } else if (state != std::string::npos && ticks.back().ends_with(':')) {
                ticks.back().pop_back(); // the first section with this line
                ticks.back() += " " + line.substr(state + kState.size());
            }
        }
        return ticks;
    }
};

TEST_F(EndToEndSteps, TheTicksOfDecodeAndOfTheViewerAreTheSameAndBothTellOfTheSteps) {
    const std::string recording = record("a.pcap", {{seconds(7200), registration(0)},
                                                    {milliseconds(7'203'100), registration(2)},
                                                    {seconds(7205), registration(0)},
                                                    {milliseconds(100), registration(2)},
                                                    {seconds(1), registration(0)},
                                                    {milliseconds(2100), registration(2)},
                                                    {milliseconds(900), registration(0)},
                                                    {seconds(65), registration(2)},
                                                    {milliseconds(65'100), registration(0)},
                                                    {seconds(50), registration(2)}});
    const Lines expected{
        "2023-11-15 00:13:22 REG_STATE_INACTIVE",   "2023-11-15 00:13:24 REG_STATE_REGISTERING",
        "2023-11-15 00:13:26 REG_STATE_INACTIVE",   "2023-11-14 22:13:22 REG_STATE_INACTIVE",
        "2023-11-14 22:13:24 REG_STATE_INACTIVE",   "2023-11-14 22:14:26 REG_STATE_INACTIVE",
        "2023-11-14 22:14:12 REG_STATE_REGISTERING"};
    const std::string told = "pallax: " + recording +
                             ": packet 4 is 7204.9 s earlier than the latest packet before it; "
                             "ticks are counted from there.\n"
                             "pallax: " +
                             recording +
                             ": no packets for 62.9 s before packet 8.\n"
                             "pallax: " +
                             recording +
                             ": packet 10 is 15.1 s earlier than the latest packet before it; "
                             "ticks are counted from there.\n";
    EXPECT_EQ(decodedTicks(recording), expected);
    const Run decoded = run({"decode", recording});
    EXPECT_EQ(decoded.status, 0);
    EXPECT_EQ(decoded.err, told);
    const Run played = run({recording, "--print", "--speed", "max"});
    EXPECT_EQ(played.status, 0);
    EXPECT_EQ(played.err, told);
    EXPECT_EQ(printedTicks(played.out), expected);
}

TEST_F(EndToEndSteps, AStepAtAPacketThatTheViewerDoesNotAskForIsOneToo) {
    const std::string recording = record("a.pcap", {{seconds(100), registration(0)},
                                                    {seconds(109), unwanted()},
                                                    {seconds(99), unwanted()},
                                                    {milliseconds(100'500), registration(2)},
                                                    {milliseconds(101'500), registration(0)}});
    const Run played = run({recording, "--print", "--speed", "max"});
    EXPECT_EQ(played.err, "pallax: " + recording +
                              ": packet 3 is 10.0 s earlier than the latest packet before it; "
                              "ticks are counted from there.\n");
    EXPECT_EQ(played.err, run({"decode", recording}).err);
    EXPECT_EQ(printedTicks(played.out), (Lines{"2023-11-14 22:15:02 REG_STATE_INACTIVE",
                                               "2023-11-14 22:15:01 REG_STATE_REGISTERING",
                                               "2023-11-14 22:15:03 REG_STATE_INACTIVE"}));
}

TEST_F(EndToEndSteps, OneStampAnHourAheadLeavesTheTicksOfTheOthers) {
    std::vector<Packet> packets;
    for (int count = 0; count < 240; ++count) { // two minutes
        const seconds ahead(count == 9 ? 3600 : 0);
        packets.emplace_back(milliseconds(500) * count + ahead,
                             registration(count % 2 == 0 ? 0 : 2));
    }
    const std::string recording = record("a.pcap", packets);
    const Lines decoded = decodedTicks(recording);
    EXPECT_EQ(decoded.size(), 62U); // 60 without that stamp
    EXPECT_EQ(printedTicks(run({recording, "--print", "--speed", "max"}).out), decoded);
}

TEST_F(EndToEndSteps, AtItsOwnPaceARecordingGoesOnAtOnceWhereItsStampsStepBack) {
    const std::string recording =
        record("a.pcap", {{seconds(3600), registration(0)}, {seconds(0), registration(2)}});
    EXPECT_EQ(printedTicks(run({recording, "--print"}).out),
              (Lines{"2023-11-14 23:13:22 REG_STATE_INACTIVE",
                     "2023-11-14 22:13:22 REG_STATE_REGISTERING"}));
}

TEST_F(EndToEndSteps, SecondsAfter2038AndStampsThatAreNoTimesAreTheSameInDecodeAndInPrint) {
    // 2100-01-01 in pcap, whose seconds have 32 bits, with a fraction above a second.
    const std::string recording = record("a.pcap", {{seconds(0), registration(0)}});
    std::string bytes = doubles::contentOf(recording);
    constexpr std::size_t kSecondsAt = 24;
    bytes.replace(kSecondsAt, 4, std::string("\x00\x57\x86\xF4", 4)); // 4102444800
    std::ofstream(recording, std::ios::binary) << bytes;
    EXPECT_EQ(decodedTicks(recording), Lines{"2100-01-01 00:00:02 REG_STATE_INACTIVE"});
    const Run played = run({recording, "--print", "--speed", "max"});
    EXPECT_EQ(played.err, "");
    EXPECT_EQ(printedTicks(played.out), decodedTicks(recording));

    bytes.replace(kSecondsAt + 4, 4, "\xFF\xFF\xFF\x7F");
    std::ofstream(recording, std::ios::binary) << bytes;
    const std::string told = "pallax: " + recording +
                             ": the stamp of packet 1 is not between 1970 and 2255; the nearest "
                             "time replaces it and others like it.\n";
    EXPECT_EQ(run({"decode", recording}).err, told);
    EXPECT_EQ(run({recording, "--print", "--speed", "max"}).err, told);
}

TEST_F(EndToEndSteps, WhileAPlayedStreamPausesItsClockRunsOn) {
    const std::string pipe = world.path("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    const Descriptor both(::open(pipe.c_str(), O_RDWR | O_CLOEXEC)); // does not wait
    PallaxProcess viewer(world, {"-", "--print"}, pipe);
    const auto writer = RecordingWriter::create(pipe, kGsmLinkType);
    ASSERT_TRUE(writer);
    EXPECT_EQ((*writer)->write(kSampleStart, registration(2)), std::nullopt);
    EXPECT_TRUE(viewer.says("MM Service State: REG_STATE_REGISTERING\n"));
    const std::string shown = viewer.out();
    EXPECT_GE(shown.substr(shown.find("== ")), "== 2023-11-14 22:13:22 +0000\n")
        << "not the time of the last packet";
    viewer.signal(SIGTERM);
    EXPECT_EQ(viewer.wait(), 0);
}

TEST_F(EndToEndScreen, AStepOfTheStampsIsANoteBesideTheStatus) {
    PallaxTerminal terminal(
        world, {record("a.pcap", {{seconds(0), registration(0)}, {seconds(61), registration(2)}})},
        {});
    EXPECT_TRUE(terminal.shows("No packets for 61.0 s before packet 2"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

/// A live stream, `pallax service --relay -`, with stamps set by the test.
class EndToEndLiveClock : public EndToEnd {
protected:
    EndToEndLiveClock() {
        EXPECT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
        const Descriptor both(::open(pipe.c_str(), O_RDWR | O_CLOEXEC)); // does not wait
        service.emplace(world, Lines{"service", "--relay", "-"}, pipe);
        auto writer = RecordingWriter::create(pipe, kGsmLinkType);
        EXPECT_TRUE(writer);
        device = std::move(writer).value();
        EXPECT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    }

    void send(milliseconds sinceStart, unsigned state) const {
        EXPECT_EQ(device->write(kSampleStart + sinceStart, registration(state)), std::nullopt);
    }
    bool aClientStreams() const {
        return eventually([&] {
            return run({"service", "--status"}).out.find(": streaming") != std::string::npos;
        });
    }
    void end(PallaxProcess& client) {
        client.signal(SIGTERM);
        EXPECT_EQ(client.wait(), 0);
        service->signal(SIGTERM);
        EXPECT_EQ(service->wait(), 0);
    }

    std::string pipe = world.path("device");
    std::unique_ptr<RecordingWriter> device;
    std::optional<PallaxProcess> service;
};

TEST_F(EndToEndLiveClock, AClockThatWasSetBackFreezesNoDisplayAndItsDatesAreThePresent) {
    const std::time_t began = std::time(nullptr);
    PallaxProcess viewer(world, {"--print"});
    ASSERT_TRUE(aClientStreams());
    send(seconds(3600), 0);
    EXPECT_TRUE(viewer.says("MM Service State: REG_STATE_INACTIVE\n"));
    send(seconds(0), 2);
    EXPECT_TRUE(viewer.says("MM Service State: REG_STATE_REGISTERING\n"));
    send(milliseconds(1), 0);
    EXPECT_TRUE(viewer.says("* MM Service State: REG_STATE_INACTIVE\n"));
    std::istringstream lines(viewer.out());
    int dates = 0;
    for (std::string line; std::getline(lines, line);) {
        if (line.starts_with("== ")) {
            std::tm date{};
            ASSERT_NE(::strptime(line.c_str(), "== %Y-%m-%d %H:%M:%S +0000", &date), nullptr);
            EXPECT_GE(::timegm(&date), began) << line;
            ++dates;
        }
    }
    EXPECT_GE(dates, 3);
    end(viewer);
}

TEST_F(EndToEndLiveClock, AClosedPortIsNoticedWithAnyStamps) {
    PallaxProcess viewer(world, {"--log-level", "3"});
    ASSERT_TRUE(aClientStreams());
    send(seconds(3600), 0);
    send(seconds(0), 2);
    EXPECT_TRUE(viewer.says("MM Service State: "));
    service->signal(SIGKILL);
    EXPECT_EQ(service->wait(), -SIGKILL);
    EXPECT_TRUE(viewer.says(" ***** INVALIDATED "));
    EXPECT_TRUE(viewer.says("Connecting...\n"));
    viewer.signal(SIGTERM);
    EXPECT_EQ(viewer.wait(), 0);
}

TEST_F(EndToEndLiveClock, ARecorderWritesTheStampsAsTheyAre) {
    std::vector<milliseconds> sent;
    for (int count = 0; count < 240; ++count) {
        sent.push_back(milliseconds(500) * count + seconds(count == 9 ? 3600 : 0));
    }
    const std::string file = world.path("a.pcapng");
    PallaxProcess recorder(world, {"record", file});
    ASSERT_TRUE(aClientStreams());
    for (const auto stamp : sent) {
        send(stamp, 0);
    }
    device.reset();
    EXPECT_EQ(recorder.wait(), 0);
    EXPECT_EQ(service->wait(), 0);
    std::vector<milliseconds> recorded;
    const auto recording = Recording::open(file);
    ASSERT_TRUE(recording);
    while (const auto packet = (*recording)->next()) {
        recorded.push_back(std::chrono::duration_cast<milliseconds>(packet->time - kSampleStart));
    }
    EXPECT_EQ(recorded, sent);
}

} // namespace
} // namespace pallax
