#include "host/Recording.h"
#include "tests/cli/EndToEnd.h"
#include "tests/cli/PallaxTerminal.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Pattern.h"

#include <algorithm>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <sys/resource.h>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;
using std::chrono::seconds;

/// `pallax record` with a service.
class EndToEndRecord : public EndToEnd {
protected:
    /// Ten registrations a second.
    std::string registrations(const std::string& name, int count) const {
        std::vector<Packet> packets;
        for (int index = 0; index < count; ++index) {
            packets.emplace_back(milliseconds(100) * index, registration(index % 2 == 0 ? 0 : 2));
        }
        return record(name, packets);
    }
    bool serviceIsThere() const {
        return eventually([this] { return !world.sockets().empty(); });
    }
    int packetsIn(const std::string& path) const {
        const auto recording = Recording::open(path);
        int count = 0;
        while (recording && (*recording)->next()) {
            ++count;
        }
        return recording && !(*recording)->error() ? count : -1;
    }
    /// The decoded ticks of a recording, one line each.
    std::string ticksOf(const std::string& path) const {
        const Run decoded = run({"decode", "--every", "tick", path});
        EXPECT_EQ(decoded.status, 0) << decoded.err;
        return decoded.out;
    }
    void end(PallaxProcess& process) const {
        process.signal(SIGTERM);
        EXPECT_EQ(process.wait(), 0);
    }
};

TEST_F(EndToEndRecord, WhatIsRecordedDecodesLikeTheRecordingThatWasPlayed) {
    const std::string played = gsmAttach();
    PallaxProcess service(world, {"service", "--play", played, "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    const std::string file = world.path("recorded.pcapng");
    const Run recorded = run({"record", file});
    EXPECT_EQ(recorded.status, 0);
    EXPECT_EQ(recorded.out, "");
    EXPECT_EQ(recorded.err, "") << "no progress without a terminal";
    const std::string ticks = ticksOf(played);
    EXPECT_GT(ticks.size(), 1000U);
    EXPECT_EQ(ticksOf(file), ticks);
    end(service);
    EXPECT_TRUE(eventually([this] { return world.sockets().empty(); }));
}

TEST_F(EndToEndRecord, EverySampleIsRecordedSoThatItDecodesTheSame) {
    for (const SampleRecording& sample : samples()) {
        const std::string played = world.path(std::string(sample.fileName));
        ASSERT_EQ(writeSample(sample, played), std::nullopt);
        PallaxProcess service(world, {"service", "--play", played, "--speed", "max"});
        ASSERT_TRUE(serviceIsThere());
        const std::string file = played + ".pcapng";
        EXPECT_EQ(run({"record", file}).status, 0);
        EXPECT_EQ(ticksOf(file), ticksOf(played)) << sample.fileName;
        end(service);
    }
}

TEST_F(EndToEndRecord, StandardOutputIsARecordingToo) {
    const std::string played = registrations("a.pcap", 20);
    PallaxProcess service(world, {"service", "--play", played, "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    const std::string file = world.path("piped.pcapng");
    PallaxProcess recorder(world, {"record", "-"}, "/dev/null", file);
    EXPECT_EQ(recorder.wait(), 0);
    EXPECT_EQ(ticksOf(file), ticksOf(played));
    end(service);
}

TEST_F(EndToEndRecord, AViewerAndTwoRecordersRunAtOnce) {
    PallaxProcess service(
        world, {"service", "--play", registrations("a.pcap", 100), "--loop", "--speed", "10"});
    ASSERT_TRUE(serviceIsThere());
    PallaxProcess viewer(world, {});
    PallaxProcess first(world, {"record", world.path("first.pcapng")});
    PallaxProcess second(world, {"record", world.path("second.pcapng")});
    EXPECT_TRUE(viewer.says("REG_STATE_"));
    for (const char* name : {"first.pcapng", "second.pcapng"}) {
        EXPECT_TRUE(eventually([&] { return packetsIn(world.path(name)) > 20; })) << name;
    }
    const std::string shown = viewer.out();
    EXPECT_TRUE(eventually([&] { return viewer.out().size() > shown.size(); }));
    for (PallaxProcess* process : {&first, &second, &viewer, &service}) {
        end(*process);
    }
    EXPECT_GT(packetsIn(world.path("first.pcapng")), 20);
    EXPECT_TRUE(eventually([this] { return world.sockets().empty(); }));
}

TEST_F(EndToEndRecord, AKilledRecorderLeavesAWholeRecording) {
    PallaxProcess service(
        world, {"service", "--play", registrations("a.pcap", 100), "--loop", "--speed", "100"});
    ASSERT_TRUE(serviceIsThere());
    const std::string file = world.path("a.pcapng");
    PallaxProcess recorder(world, {"record", file});
    EXPECT_TRUE(eventually([&] { return packetsIn(file) > 50; }));
    recorder.signal(SIGKILL);
    EXPECT_EQ(recorder.wait(), -SIGKILL);
    EXPECT_GT(packetsIn(file), 50);
    end(service);
}

TEST_F(EndToEndRecord, FilesAreRotatedByTheTimeOfTheirPackets) {
    PallaxProcess service(world,
                          {"service", "--play", registrations("a.pcap", 30), "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    EXPECT_EQ(run({"record", "--rotate-seconds", "1", world.path("a.pcapng")}).status, 0);
    for (const char* name : {"a-0001.pcapng", "a-0002.pcapng", "a-0003.pcapng"}) {
        EXPECT_EQ(packetsIn(world.path(name)), 10) << name;
    }
    EXPECT_FALSE(std::filesystem::exists(world.path("a-0004.pcapng")));
    end(service);
}

TEST_F(EndToEndRecord, AFileThatExistsIsNotTouched) {
    const std::string file = registrations("a.pcap", 1);
    const Run refused = run({"record", file});
    EXPECT_EQ(refused.status, 1);
    EXPECT_EQ(refused.err, "pallax: " + file + " exists already; --overwrite replaces it.\n");
    EXPECT_EQ(packetsIn(file), 1);
}

TEST_F(EndToEndRecord, AnotherTechnologyThanTheWantedOneIsRefused) {
    PallaxProcess service(world, {"service", "--play", registrations("a.pcap", 1)});
    ASSERT_TRUE(serviceIsThere());
    const Run refused = run({"record", "--technology", "lte", world.path("a.pcapng")});
    EXPECT_EQ(refused.status, 1);
    EXPECT_EQ(refused.err, "pallax: The modem's technology is Zorell_GSM (gsm), not lte.\n");
    EXPECT_EQ(run({"record", "--technology", "gsm", world.path("b.pcapng")}).status, 0);
    EXPECT_EQ(packetsIn(world.path("b.pcapng")), 1);
    end(service);
}

TEST_F(EndToEndRecord, AFullDiskEndsItWithASentenceAndTheFileUpToThereIsWhole) {
    PallaxProcess service(world,
                          {"service", "--play", registrations("a.pcap", 1000), "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    const Run full = run({"record", "--overwrite", "/dev/full"});
    EXPECT_EQ(full.status, 1);
    EXPECT_EQ(full.err,
              "pallax: The recording /dev/full cannot be written: No space left on device.\n");

    rlimit before{};
    ::getrlimit(RLIMIT_FSIZE, &before);
    const rlimit small{4096, before.rlim_max};
    // A build with coverage would also reach the limit with its profile.
    world.environment.emplace_back("LLVM_PROFILE_FILE=/dev/null");
    const std::string file = world.path("a.pcapng");
    ::setrlimit(RLIMIT_FSIZE, &small);
    PallaxProcess recorder(world, {"record", file});
    ::setrlimit(RLIMIT_FSIZE, &before);
    EXPECT_EQ(recorder.wait(), 1);
    const int packets = packetsIn(file);
    EXPECT_GT(packets, 50);
    EXPECT_EQ(recorder.err(), "pallax: The recording " + file +
                                  " cannot be written: File too large. " + std::to_string(packets) +
                                  " packets are recorded.\n");
    end(service);
}

TEST_F(EndToEndRecord, WithoutAServiceItWaitsAndASignalEndsIt) {
    PallaxProcess recorder(world, {"record", "--log-level", "3", world.path("a.pcapng")});
    EXPECT_TRUE(recorder.says("<3>Could not create HXServerConnection\n"));
    EXPECT_TRUE(recorder.says("<3>Could not create the ports necessary\n"));
    end(recorder);
    EXPECT_TRUE(world.sockets().empty());
}

TEST_F(EndToEndRecord, OnATerminalItTellsHowFarItHasCome) {
    doubles::PallaxTerminal terminal(world, {"record", world.path("a.pcapng")}, {});
    EXPECT_TRUE(terminal.shows("0 packets, 0 bytes, waiting for the modem"));
    terminal.signal(SIGINT);
    EXPECT_EQ(terminal.wait(), 0);

    PallaxProcess service(world,
                          {"service", "--play", registrations("b.pcap", 1000), "--speed", "2"});
    ASSERT_TRUE(serviceIsThere());
    doubles::PallaxTerminal recording(world, {"record", world.path("b.pcapng")}, {});
    EXPECT_TRUE(recording.shows(" packets/s"));
    recording.signal(SIGINT);
    EXPECT_EQ(recording.wait(), 0);
    EXPECT_TRUE(recording.bytes().ends_with("\r\n")) << "the shell's prompt is on its own line";
    end(service);
}

TEST_F(EndToEndRecord, AfterAKilledServiceItGoesOnInTheSameFile) {
    const std::vector<std::string> arguments{"service", "--play",  registrations("a.pcap", 100),
                                             "--loop",  "--speed", "50"};
    const std::string file = world.path("a.pcapng");
    std::optional<PallaxProcess> service(std::in_place, world, arguments);
    ASSERT_TRUE(serviceIsThere());
    PallaxProcess recorder(world, {"record", file});
    EXPECT_TRUE(eventually([&] { return packetsIn(file) > 40; })); // four seconds of stamps
    service->signal(SIGKILL);
    EXPECT_EQ(service->wait(), -SIGKILL);
    const int before = packetsIn(file);
    service.emplace(world, arguments);
    EXPECT_TRUE(eventually([&] { return packetsIn(file) > before + 10; }));
    end(recorder);
    end(*service);
    // The source restarted with its first packet, and so did the stamps in the file.
    const Run decoded = run({"decode", "--every", "packet", file});
    std::vector<std::string> times;
    for (const auto& match : doubles::matchesIn(decoded.out, "\"time\":\"([^\"]*)\"")) {
        times.push_back(match[1]);
    }
    EXPECT_GT(static_cast<int>(times.size()), before + 10);
    EXPECT_EQ(std::count(times.begin(), times.end(), "2023-11-14T22:13:20.000Z"), 2);
    EXPECT_TRUE(decoded.err.starts_with("pallax: " + file + ": packet ")) << decoded.err;
    EXPECT_TRUE(decoded.err.ends_with(
        " s earlier than the latest packet before it; ticks are counted from there.\n"))
        << decoded.err;
}

TEST_F(EndToEndRecord, TsharkReadsItWithoutComplaint) {
    if (std::system("command -v tshark >/dev/null") != 0) { // NOLINT(cert-env33-c)
        GTEST_SKIP() << "tshark is not installed";
    }
    PallaxProcess service(world,
                          {"service", "--simulate", "gsm", "--seconds", "20", "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    const std::string file = world.path("a.pcapng");
    ASSERT_EQ(run({"record", file}).status, 0);
    const std::string said = world.path("tshark");
    const std::string command = "tshark -r " + file + " -T fields -e frame.interface_name > " +
                                world.path("names") + " 2> " + said;
    EXPECT_EQ(std::system(command.c_str()), 0); // NOLINT(cert-env33-c)
    EXPECT_EQ(doubles::contentOf(said).find("tshark: "), std::string::npos);
    const std::string names = doubles::contentOf(world.path("names"));
    EXPECT_TRUE(names.starts_with("Zorell_GSM\n"));
    EXPECT_EQ(std::count(names.begin(), names.end(), '\n'), packetsIn(file));
    EXPECT_GT(packetsIn(file), 100);
    end(service);
}

} // namespace
} // namespace pallax
