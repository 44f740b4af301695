#include "host/Recording.h"
#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"

#include <csignal>
#include <filesystem>
#include <functional>
#include <optional>

namespace pallax {
namespace {

namespace fs = std::filesystem;
using doubles::contentOf;
using doubles::eventually;
using doubles::PallaxProcess;

/// The files that `pallax record` and the system log write, and those that existed before.
class EndToEndRecordFiles : public EndToEnd {
protected:
    std::unique_ptr<PallaxProcess> serve(const std::string& modem) const {
        auto service = std::make_unique<PallaxProcess>(
            world, std::vector<std::string>{"service", "--simulate", modem, "--speed", "10"});
        EXPECT_TRUE(eventually([this] { return !world.sockets().empty(); }));
        return service;
    }
    static int packetsIn(const std::string& path) {
        const auto recording = Recording::open(path);
        int count = 0;
        while (recording && (*recording)->next()) {
            ++count;
        }
        return recording && !(*recording)->error() ? count : -1;
    }
    static bool grows(const std::string& path) {
        const int before = packetsIn(path);
        return eventually([&] { return packetsIn(path) > before + 10; });
    }
    /// Calls `meanwhile` with the file of a running recorder.
    void endsOver(const std::string& name, const std::function<void(const std::string&)>& meanwhile,
                  const std::string& what) const {
        const std::string file = world.path(name);
        PallaxProcess recorder(world, {"record", file});
        EXPECT_TRUE(grows(file));
        meanwhile(file);
        EXPECT_EQ(recorder.wait(), 1) << "it ends by itself";
        EXPECT_EQ(recorder.err(), "pallax: The recording " + file + " was " + what +
                                      " while it was being written. 0 packets are recorded.\n");
    }
};

TEST_F(EndToEndRecordFiles, WithoutAPacketStayAsTheyWere) {
    const std::string earlier = gsmAttach();
    const std::string content = contentOf(earlier);
    for (const std::string& file : {earlier, world.path("new.pcapng")}) {
        PallaxProcess recorder(world, {"record", "--overwrite", "--log-level", "3", file});
        EXPECT_TRUE(recorder.says("<3>Could not create the ports necessary\n"));
        recorder.signal(SIGINT);
        EXPECT_EQ(recorder.wait(), 0);
    }
    EXPECT_EQ(contentOf(earlier), content);
    EXPECT_FALSE(fs::exists(world.path("new.pcapng")));
}

TEST_F(EndToEndRecordFiles, AreReplacedByTheFirstPacket) {
    const std::string file = gsmAttach();
    const auto service = serve("lte");
    PallaxProcess recorder(world, {"record", "--overwrite", file});
    EXPECT_TRUE(eventually([&] {
        const auto recording = Recording::open(file);
        return recording && (*recording)->linkType() == 150 && (*recording)->next();
    }));
    recorder.signal(SIGINT);
    EXPECT_EQ(recorder.wait(), 0);
    EXPECT_GT(packetsIn(file), 0);
}

TEST_F(EndToEndRecordFiles, ThatCannotBeWrittenAreToldAtTheStart) {
    for (const std::string& file : {world.path("missing/a.pcapng"), world.path()}) {
        EXPECT_EQ(run({"record", "--overwrite", file}).status, 1) << file;
    }
}

TEST_F(EndToEndRecordFiles, ThatAreBeingWrittenTakeNoSecondRecorder) {
    const auto service = serve("gsm");
    const std::string file = world.path("a.pcapng");
    PallaxProcess recorder(world, {"record", file});
    EXPECT_TRUE(grows(file));
    const Run second = run({"record", "--overwrite", file});
    EXPECT_EQ(second.status, 1);
    EXPECT_EQ(second.err, "pallax: " + file + " is being read or written by another program.\n");
    EXPECT_TRUE(grows(file)) << "the first is unaffected";
    recorder.signal(SIGINT);
    EXPECT_EQ(recorder.wait(), 0);
    EXPECT_EQ(recorder.err(), "");
}

TEST_F(EndToEndRecordFiles, ThatAServicePlaysAreNotReplaced) {
    const std::string played = gsmAttach();
    const std::string before = doubles::contentOf(played);
    PallaxProcess service(world, {"service", "--play", played, "--speed", "max"});
    ASSERT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    const Run refused = run({"record", "--overwrite", played});
    EXPECT_EQ(refused.status, 1);
    EXPECT_EQ(refused.err, "pallax: " + played + " is being read or written by another program.\n");
    EXPECT_EQ(doubles::contentOf(played), before);
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
}

TEST_F(EndToEndRecordFiles, ThatAreRemovedMovedOrReplacedEndTheRecorder) {
    const auto service = serve("gsm");
    const std::string gone = "removed, moved or replaced";
    endsOver(
        "a.pcapng", [](const std::string& file) { fs::remove(file); }, gone);
    endsOver(
        "b.pcapng", [](const std::string& file) { fs::rename(file, file + ".old"); }, gone);
    EXPECT_GT(packetsIn(world.path("b.pcapng.old")), 0);
    const std::string other = gsmAttach();
    endsOver(
        "c.pcapng", [&](const std::string& file) { fs::rename(other, file); }, gone);
    endsOver(
        "d.pcapng", [](const std::string& file) { fs::resize_file(file, 0); },
        "changed by another program");
}

TEST_F(EndToEndRecordFiles, ThatAreRemovedWhileNothingComesAreToldAtTheEnd) {
    PallaxProcess service(world, {"service", "--play", gsmAttach(), "--speed", "1"});
    ASSERT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    const std::string file = world.path("a.pcapng");
    PallaxProcess recorder(world, {"record", file});
    EXPECT_TRUE(eventually([&] { return packetsIn(file) > 0; }));
    service.signal(SIGSTOP);
    const int before = packetsIn(file);
    EXPECT_TRUE(eventually([&, last = before]() mutable {
        return std::exchange(last, packetsIn(file)) == last; // the last packets have arrived
    }));
    fs::remove(file);
    recorder.signal(SIGINT);
    EXPECT_EQ(recorder.wait(), 1);
    EXPECT_EQ(recorder.err(), "pallax: The recording " + file +
                                  " was removed, moved or replaced while it was being written. "
                                  "0 packets are recorded.\n");
    service.signal(SIGCONT);
}

TEST_F(EndToEndRecordFiles, HoldOneTechnologyEach) {
    std::unique_ptr<PallaxProcess> service = serve("gsm");
    const std::string file = world.path("drive.pcapng");
    const std::string rotated = world.path("rotated.pcapng");
    const std::string piped = world.path("piped.pcapng");
    PallaxProcess recorder(world, {"record", file});
    PallaxProcess rotating(world, {"record", "--rotate-size", "1G", rotated});
    PallaxProcess piping(world, {"record", "-"}, "/dev/null", piped);
    for (const std::string& path : {file, world.path("rotated-0001.pcapng"), piped}) {
        EXPECT_TRUE(grows(path)) << path;
    }
    service.reset();
    service = serve("lte");
    const std::string second = world.path("drive-2.pcapng");
    const std::string secondRotated = world.path("rotated-0002.pcapng");
    EXPECT_TRUE(grows(second));
    EXPECT_TRUE(grows(secondRotated));
    EXPECT_EQ(piping.wait(), 1);
    EXPECT_EQ(piping.err(), "pallax: The modem now speaks Zorell_LTE (lte), and a recording holds "
                            "one technology only. " +
                                std::to_string(packetsIn(piped)) + " packets are recorded.\n");
    recorder.signal(SIGINT);
    rotating.signal(SIGINT);
    EXPECT_EQ(recorder.wait(), 0);
    EXPECT_EQ(rotating.wait(), 0);
    const std::string sentence =
        "pallax: The modem now speaks Zorell_LTE (lte); recording continues in ";
    EXPECT_EQ(recorder.err(), sentence + second + ".\n");
    EXPECT_EQ(rotating.err(), sentence + secondRotated + ".\n");
    for (const std::string& path : {file, second, secondRotated, piped}) {
        EXPECT_EQ(run({"decode", path}).status, 0) << path;
    }
}

TEST_F(EndToEndRecordFiles, ASystemLogReplacesNoRecording) {
    const std::string recording = gsmAttach();
    const std::string content = contentOf(recording);
    const std::string link = world.path("link");
    const std::string symbolic = world.path("symbolic");
    fs::create_hard_link(recording, link);
    fs::create_symlink(recording, symbolic);
    const std::string other = record("other.pcap", {});
    for (const std::string& log : {recording, link, symbolic}) {
        const Run refused = run({"decode", "--system-log", log, other, recording});
        EXPECT_EQ(refused.status, 1);
        EXPECT_EQ(refused.out, "");
        EXPECT_EQ(refused.err, "pallax: The system log " + log + " would replace the recording " +
                                   recording + ".\n");
    }
    const Run piped = run({"decode", "--system-log", link, "-"}, recording);
    EXPECT_EQ(piped.status, 1);
    EXPECT_EQ(piped.err, "pallax: The system log " + link +
                             " would replace the recording of standard input.\n");
    EXPECT_EQ(contentOf(recording), content);
    const std::string log = world.path("log");
    EXPECT_EQ(run({"decode", "--system-log", log, recording}).status, 0);
    EXPECT_EQ(run({"decode", "--system-log", log, recording}).status, 0) << "a log is replaced";
}

TEST_F(EndToEndRecordFiles, WithNumbersHaveTheNameOfAFile) {
    for (const char* path : {"/dev/null", "/tmp", ".."}) {
        const Run refused = run({"record", "--overwrite", "--rotate-size", "1k", path});
        EXPECT_EQ(refused.status, 1);
        EXPECT_EQ(refused.err,
                  std::string("pallax: A recording in several files needs the name of a file, "
                              "which ") +
                      path + " is not.\n");
    }
    EXPECT_EQ(run({"record", "--rotate-size", "1k", ""}).status, 2);
}

} // namespace
} // namespace pallax
