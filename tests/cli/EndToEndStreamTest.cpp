#include "host/Descriptor.h"
#include "host/Recording.h"
#include "tests/cli/EndToEndScreen.h"
#include "tests/doubles/Shell.h"

#include <csignal>
#include <fcntl.h>
#include <optional>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;

constexpr const char* kLastState = "  MM Service State: REG_STATE_REGISTERING\n";

/// Recordings that come through a named pipe.
class EndToEndStream : public EndToEndScreen {
protected:
    EndToEndStream() { EXPECT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0); }
    ~EndToEndStream() override {
        if (_writer.joinable()) {
            _writer.join();
        }
    }

    /// Writes a recording into the pipe when it has a reader, as `cat` does.
    void feed(const std::string& recording) {
        _writer = std::thread([this, bytes = contentOf(recording)] {
            const Descriptor writer(::open(pipe.c_str(), O_WRONLY | O_CLOEXEC));
            EXPECT_EQ(::write(writer.number(), bytes.data(), bytes.size()),
                      static_cast<ssize_t>(bytes.size()));
        });
    }

    /// The program's command line for a shell outside its world.
    std::string shellCommand(const std::string& arguments) const {
        std::string command = "env";
        for (const std::string& setting : doubles::programEnvironment(world)) {
            command += " '" + setting + "'";
        }
        return command + " " + doubles::programPath() + " " + arguments;
    }

    std::string pipe = world.path("wire");

private:
    std::thread _writer;
};

TEST_F(EndToEndStream, IsBrowsedInPrint) {
    feed(brief());
    const Run result = run({"--print", pipe, "--speed", "max"});
    EXPECT_EQ(result.status, 0);
    EXPECT_EQ(result.err, "");
    EXPECT_NE(result.out.find(kLastState), std::string::npos) << result.out;
    expectNothingLeft();
}

TEST_F(EndToEndStream, IsBrowsedOnTheScreen) {
    feed(brief());
    PallaxTerminal terminal(world, {pipe, "--speed", "max"}, {});
    EXPECT_TRUE(terminal.shows("End of the recording"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndStream, OfAShellsCommandIsRead) {
    const std::string recording = brief();
    for (const char* arguments : {"--print --speed max", "decode"}) {
        const auto result = doubles::runCommand(
            "bash -c \"" + shellCommand(std::string(arguments) + " <(cat " + recording + ")") +
            "\"");
        EXPECT_EQ(result.status, 0) << result.out;
        EXPECT_NE(result.out.find("REG_STATE_REGISTERING"), std::string::npos) << result.out;
        EXPECT_EQ(result.out.find("pallax: "), std::string::npos) << result.out;
    }
}

TEST_F(EndToEndStream, OnADescriptorThatTheServiceWouldUseItselfIsRead) {
    const auto result = doubles::runCommand("cat " + brief() + " | { exec 3<&0 </dev/null; " +
                                            shellCommand("--print --speed max /dev/fd/3") + "; }");
    EXPECT_EQ(result.status, 0) << result.out;
    EXPECT_NE(result.out.find(kLastState), std::string::npos) << result.out;
}

TEST_F(EndToEndStream, IsDecoded) {
    feed(brief());
    const Run whole = run({"decode", pipe});
    EXPECT_EQ(whole.status, 0);
    EXPECT_EQ(whole.err, "");
    EXPECT_EQ(whole.out, run({"decode", brief()}).out);
}

TEST_F(EndToEndStream, IsPlayedByAServiceToItsFirstClient) {
    feed(gsmAttach());
    PallaxProcess service(world, {"service", "--play", pipe, "--speed", "max"});
    ASSERT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    const Run recorder = run({"record", world.path("first.pcapng")});
    EXPECT_EQ(recorder.status, 0) << recorder.err;
    const auto recording = Recording::open(world.path("first.pcapng"));
    ASSERT_TRUE(recording);
    int packets = 0;
    while ((*recording)->next()) {
        ++packets;
    }
    EXPECT_GT(packets, 40);
    PallaxProcess second(world, {"--print"});
    EXPECT_TRUE(service.says("pallax: " + pipe + " is already being played.\n"));
    second.signal(SIGTERM);
    EXPECT_EQ(second.wait(), 0);
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
}

TEST_F(EndToEndStream, ThatNobodyWritesToIsToldAndTheWaitIsInterruptible) {
    const std::string told =
        "pallax: Nothing has been written to " + pipe + " yet; waiting for it.\n";
    const std::vector<std::vector<std::string>> commands{
        {"--print", pipe}, {"decode", pipe}, {"service", "--play", pipe}};
    for (const auto& arguments : commands) {
        PallaxProcess process(world, arguments);
        EXPECT_TRUE(process.says(told)) << process.err();
        process.signal(SIGTERM);
        EXPECT_EQ(process.wait(), -SIGTERM);
        EXPECT_EQ(process.err(), told);
    }
    expectNothingLeft();
}

TEST_F(EndToEndStream, ThatBeginsLateIsBrowsed) {
    PallaxTerminal terminal(world, {pipe, "--speed", "max"}, {});
    EXPECT_TRUE(terminal.shows("waiting for it."));
    feed(brief());
    EXPECT_TRUE(terminal.shows("End of the recording"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndStream, ThatIsNoRecordingIsNamed) {
    feed(world.path("config/pallax/pallax.conf"));
    const Run result = run({"--print", pipe});
    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.err,
              "pallax: " + pipe + " is not a recording: it is neither pcap nor pcapng.\n");
}

TEST_F(EndToEndStream, CannotBeginAgain) {
    const Run browsed = run({pipe, "--print", "--loop"});
    EXPECT_EQ(browsed.status, 2);
    EXPECT_EQ(browsed.err, "pallax: " + pipe +
                               " can be played only once, not with --loop (see pallax --help)\n");
    const Run service = run({"service", "--play", pipe, "--loop"});
    EXPECT_EQ(service.status, 2);
    EXPECT_EQ(service.err,
              "pallax: " + pipe +
                  " can be played only once, not with --loop (see pallax service --help)\n");
}

} // namespace
} // namespace pallax
