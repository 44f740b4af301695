#include "host/Descriptor.h"
#include "host/Recording.h"
#include "tests/cli/EndToEndScreen.h"

#include <array>
#include <csignal>
#include <fcntl.h>
#include <fstream>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::noChildLeft;
using doubles::PallaxProcess;
using doubles::waitsForItsReader;
using doubles::waitsForItsReaderNow;

/// Programs with blocked output: a full pipe, or a terminal stopped with Ctrl-S.
class EndToEndStalledOutput : public EndToEndScreen {
protected:
    EndToEndStalledOutput() {
        EXPECT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
        reader = Descriptor(::open(pipe.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
        constexpr int kSmall = 4096; // soon full
        EXPECT_GT(::fcntl(reader.number(), F_SETPIPE_SZ, kSmall), 0);
    }

    /// The status of a program that gets the signal while it is blocked.
    int statusAfter(int number, const std::vector<std::string>& arguments) const {
        SCOPED_TRACE(testing::PrintToString(arguments));
        PallaxProcess process(world, arguments, "/dev/null", pipe);
        EXPECT_TRUE(waitsForItsReader(process.id()));
        process.signal(number);
        const int status = process.wait();
        EXPECT_EQ(process.err(), "");
        return status;
    }

    /// Empties the pipe and returns its content.
    std::string taken() const {
        std::string bytes;
        std::array<char, 4096> piece{};
        for (ssize_t count = 0;
             (count = ::read(reader.number(), piece.data(), piece.size())) > 0;) {
            bytes.append(piece.data(), static_cast<std::size_t>(count));
        }
        return bytes;
    }

    std::string pipe = world.path("pipe");
    Descriptor reader;
};

TEST_F(EndToEndStalledOutput, OfAPrintedTreeEndsWithTheSignal) {
    for (const int number : {SIGTERM, SIGINT, SIGHUP}) {
        std::filesystem::remove_all(world.path("config/pallax/preferences"));
        EXPECT_EQ(statusAfter(number, {"demo", "--print", "--speed", "max"}), 0) << number;
        expectHomeScreenPreference();
        (void)taken();
    }
    EXPECT_EQ(statusAfter(SIGQUIT, {"demo", "--print", "--speed", "max"}), -SIGQUIT);
    expectNothingLeft();
}

TEST_F(EndToEndStalledOutput, OfARecorderEndsWithTheSignalAndHoldsWholePackets) {
    PallaxProcess service(world, {"service", "--simulate", "lte", "--speed", "max"});
    ASSERT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    for (const int number : {SIGTERM, SIGINT, SIGHUP}) {
        EXPECT_EQ(statusAfter(number, {"record", "-"}), 0) << number;
        const std::string path = world.path("taken.pcapng");
        std::ofstream(path, std::ios::binary) << taken();
        const auto recording = Recording::open(path);
        ASSERT_TRUE(recording);
        int packets = 0;
        while ((*recording)->next()) {
            ++packets;
        }
        EXPECT_GT(packets, 10);
        EXPECT_FALSE((*recording)->error());
    }
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
}

TEST_F(EndToEndStalledOutput, OfARecordersProgressAndLogEndsWithTheSignal) {
    PallaxProcess service(world, {"service", "--simulate", "lte", "--speed", "max"});
    ASSERT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    const std::string file = world.path("drive.pcapng");
    PallaxTerminal terminal(world, {"record", file, "--log-level", "7"}, {});
    ASSERT_TRUE(terminal.shows("Starting the display update timer"));
    terminal.type("\x13"); // Ctrl-S
    EXPECT_TRUE(waitsForItsReader(terminal.id(), STDERR_FILENO));
    terminal.signal(SIGTERM);
    EXPECT_TRUE(doubles::hasEnded(terminal.id()));
    EXPECT_EQ(terminal.wait(), 0);
    const auto recording = Recording::open(file);
    ASSERT_TRUE(recording);
    while ((*recording)->next()) {
    }
    EXPECT_FALSE((*recording)->error());
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
}

TEST_F(EndToEndStalledOutput, OfDecodeAndSimulateEndsAsTheSignalDoes) {
    const std::string drive = lteDrive();
    EXPECT_EQ(statusAfter(SIGTERM, {"decode", "--every", "packet", drive}), -SIGTERM);
    EXPECT_EQ(statusAfter(SIGINT, {"decode", "--jobs", "2", "--every", "packet", drive, drive}),
              -SIGINT);
    EXPECT_EQ(statusAfter(SIGHUP, {"simulate", "lte", "--seconds", "36000", "-o", "-"}), -SIGHUP);
    EXPECT_TRUE(noChildLeft());
}

TEST_F(EndToEndStalledOutput, OfAScreenThatIsStoppedEndsWithTheSignalAndIsRestored) {
    for (const int number : {SIGTERM, SIGINT, SIGHUP, SIGQUIT}) {
        std::filesystem::remove_all(world.path("config/pallax/preferences"));
        PallaxTerminal terminal(world, {"demo", "gsm", "--speed", "20"}, {});
        ASSERT_TRUE(terminal.shows("Updated "));
        terminal.type("\x13"); // Ctrl-S
        EXPECT_TRUE(waitsForItsReader(terminal.id()));
        terminal.signal(number);
        EXPECT_EQ(terminal.wait(), number == SIGQUIT ? -SIGQUIT : 0) << number;
        EXPECT_TRUE(terminal.isRestored()) << number;
        expectHomeScreenPreference();
        expectNothingLeft();
    }
}

TEST_F(EndToEndStalledOutput, OfATerminalThatNobodyReadsEndsWithTheSignal) {
    PallaxTerminal terminal(world, {"demo", "gsm", "--speed", "20"}, {});
    ASSERT_TRUE(terminal.shows("Updated "));
    EXPECT_TRUE(eventually([&] { // the screen keeps changing and is redrawn
        terminal.type("\x0c");
        return waitsForItsReaderNow(terminal.id());
    }));
    terminal.signal(SIGTERM);
    EXPECT_TRUE(doubles::hasEnded(terminal.id())) << "its output was not read";
    EXPECT_EQ(terminal.wait(), 0);
    expectHomeScreenPreference();
    expectNothingLeft();
}

} // namespace
} // namespace pallax
