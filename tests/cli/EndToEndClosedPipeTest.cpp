#include "host/Descriptor.h"
#include "tests/cli/EndToEnd.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax {
namespace {

using doubles::PallaxProcess;

/// Runs every command that writes data, with a pipe whose reader closes it.
class EndToEndClosedPipe : public EndToEnd {
protected:
    EndToEndClosedPipe() {
        std::signal(SIGPIPE, SIG_IGN);
        EXPECT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    }

    /// Runs the command with a full pipe, so that it cannot write anything, then closes the reader.
    void endsQuietly(const std::vector<std::string>& arguments, int status = 0) const {
        SCOPED_TRACE(testing::PrintToString(arguments));
        Descriptor reader(::open(pipe.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
        Descriptor writer(::open(pipe.c_str(), O_WRONLY | O_NONBLOCK | O_CLOEXEC));
        fill(writer);
        PallaxProcess process(world, arguments, "/dev/null", pipe);
        reader.reset();
        EXPECT_EQ(process.wait(), status);
        EXPECT_EQ(process.err(), "");
    }

    /// Closes the reader while the command is writing, as `| head -c 100` does.
    void endsQuietlyAfterTheBeginning(const std::vector<std::string>& arguments) const {
        SCOPED_TRACE(testing::PrintToString(arguments));
        Descriptor reader(::open(pipe.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
        PallaxProcess process(world, arguments, "/dev/null", pipe);
        constexpr std::size_t kBeginning = 100;
        std::array<char, kBeginning> beginning{};
        EXPECT_TRUE(doubles::eventually(
            [&] { return ::read(reader.number(), beginning.data(), beginning.size()) > 0; }));
        reader.reset();
        EXPECT_EQ(process.wait(), 0);
        EXPECT_EQ(process.err(), "");
    }

    std::string lteDrive = PALLAX_SOURCE_DIR "/samples/lte-drive.pcap";
    std::string pipe = world.path("pipe");

private:
    static void fill(const Descriptor& writer) {
        const std::array<char, 1> byte{};
        std::array<char, 4096> block{};
        while (::write(writer.number(), block.data(), block.size()) > 0) {
        }
        while (::write(writer.number(), byte.data(), byte.size()) > 0) {
        }
        EXPECT_EQ(errno, EAGAIN);
    }
};

TEST_F(EndToEndClosedPipe, EndsHelpAndVersion) {
    endsQuietly({"--help"});
    endsQuietly({"--version"});
    for (const char* command :
         {"decode", "record", "service", "demo", "simulate", "events", "fields", "explain", "info",
          "snapshot", "sql", "status", "diff", "watch"}) {
        endsQuietly({command, "--help"});
    }
}

TEST_F(EndToEndClosedPipe, EndsTheTextsForPackages) {
    for (const char* shell : {"bash", "zsh", "fish"}) {
        endsQuietly({"completion", shell});
    }
    endsQuietly({"manual", "pallax-decode"});
}

TEST_F(EndToEndClosedPipe, EndsWatchWhichWritesOnlyWhatHeld) {
    endsQuietly({"watch", "tick = 1", lteDrive}, 1);
}

TEST_F(EndToEndClosedPipe, EndsInfo) {
    endsQuietly({"info", lteDrive});
    endsQuietlyAfterTheBeginning({"info", "--json", lteDrive});
}

TEST_F(EndToEndClosedPipe, EndsFields) {
    for (const std::vector<std::string>& arguments :
         {std::vector<std::string>{"fields"}, std::vector<std::string>{"fields", "--json"}}) {
        endsQuietly(arguments);
        endsQuietlyAfterTheBeginning(arguments);
    }
}

TEST_F(EndToEndClosedPipe, EndsExplain) {
    endsQuietly({"explain", "band", "lte"});
    endsQuietly({"explain", "--json", "band", "lte"});
}

TEST_F(EndToEndClosedPipe, EndsDecode) {
    endsQuietly({"decode", lteDrive});
    for (const char* every : {"end", "tick", "packet"}) {
        for (const char* format : {"json", "csv"}) {
            endsQuietly({"decode", "--every", every, "--format", format, lteDrive});
        }
    }
    endsQuietlyAfterTheBeginning({"decode", "--every", "packet", lteDrive});
}

TEST_F(EndToEndClosedPipe, EndsDecodeOfSeveralAtOnce) {
    const std::vector<std::string> arguments{"decode", "--jobs", "2",      "--every",
                                             "packet", lteDrive, lteDrive, lteDrive};
    endsQuietly(arguments);
    endsQuietlyAfterTheBeginning(arguments);
    EXPECT_TRUE(doubles::noChildLeft());
}

TEST_F(EndToEndClosedPipe, EndsBrowsingInPrint) {
    endsQuietly({lteDrive, "--print", "--speed", "max"});
    endsQuietly({"demo", "--print", "--speed", "max"});
    endsQuietlyAfterTheBeginning({"demo", "gsm", "--print", "--speed", "max"});
    EXPECT_TRUE(doubles::noChildLeft());
    EXPECT_EQ(world.sockets(), std::vector<std::string>());
}

TEST_F(EndToEndClosedPipe, EndsTheLivePage) {
    endsQuietly({"web", "demo", "gsm"});
    EXPECT_TRUE(doubles::noChildLeft());
}

TEST_F(EndToEndClosedPipe, EndsSimulate) {
    const std::vector<std::string> arguments{"simulate", "lte", "--seconds", "36000", "-o", "-"};
    endsQuietly(arguments);
    endsQuietlyAfterTheBeginning(arguments);
}

TEST_F(EndToEndClosedPipe, EndsWhatNeedsAService) {
    PallaxProcess service(world, {"service", "--simulate", "lte", "--speed", "max"});
    ASSERT_TRUE(doubles::eventually([this] { return !world.sockets().empty(); }));
    endsQuietly({"service", "--status"});
    endsQuietly({"record", "-"});
    endsQuietlyAfterTheBeginning({"record", "-"});
    endsQuietly({"--print"});
    endsQuietlyAfterTheBeginning({"--print"});
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
    EXPECT_EQ(service.err(), "");
}

TEST_F(EndToEndClosedPipe, OfStandardErrorLeavesTheStatusOfWrongUsage) {
    for (const char* nobody : {" 2>/dev/full", " 2>&-"}) {
        const std::string line = doubles::programPath() + " decode --every day" + nobody;
        const int status = std::system(line.c_str()); // NOLINT(cert-env33-c)
        EXPECT_EQ(WEXITSTATUS(status), 2) << nobody;
    }
}

} // namespace
} // namespace pallax
