#include "tests/cli/EndToEndScreen.h"

#include <algorithm>
#include <fcntl.h>
#include <fstream>
#include <sys/stat.h>
#include <thread>

namespace pallax {
namespace {

using doubles::PallaxProcess;
using std::chrono::milliseconds;

/// Runs that take long because their input comes slowly.
class EndToEndProgress : public EndToEndScreen {
protected:
    /// Writes the sample into these pipes, byte by byte, over about three seconds.
    class SlowModem {
    public:
        SlowModem(std::string sample, std::vector<std::string> pipes)
            : _thread([sample = std::move(sample), pipes = std::move(pipes)] {
                  std::vector<std::ofstream> streams;
                  for (const std::string& pipe : pipes) {
                      streams.emplace_back(pipe, std::ios::binary);
                  }
                  constexpr std::size_t kPieces = 100;
                  const std::size_t piece = sample.size() / kPieces;
                  for (std::size_t at = 0; at < sample.size(); at += piece) {
                      for (std::ofstream& stream : streams) {
                          stream << sample.substr(at, piece) << std::flush;
                      }
                      std::this_thread::sleep_for(milliseconds(30));
                  }
              }) {}
        ~SlowModem() { _thread.join(); }
        SlowModem(const SlowModem&) = delete;
        SlowModem& operator=(const SlowModem&) = delete;

    private:
        std::thread _thread;
    };

    std::string pipe(const std::string& name) const {
        std::string path = world.path(name);
        EXPECT_EQ(::mkfifo(path.c_str(), S_IRUSR | S_IWUSR), 0);
        return path;
    }

    std::string sample = contentOf(PALLAX_SOURCE_DIR "/samples/lte-drive.pcap");
};

TEST_F(EndToEndProgress, OnATerminalItAppearsAndIsWiped) {
    const std::string one = pipe("one.pcap");
    const std::string first = pipe("first.pcap");
    const std::string second = pipe("second.pcap");
    const std::string plain = pipe("plain.pcap");
    const PallaxTerminal::Setup wide{.columns = 200};
    const std::string nothing = world.path("nothing");
    PallaxTerminal alone(world, {"-c", doubles::programPath() + " decode " + one + " >" + nothing},
                         {.program = "/bin/sh"});
    PallaxTerminal both(world, {"decode", "--jobs", "2", "--every", "tick", first, second}, wide);
    PallaxProcess noTerminal(world, {"decode", plain});
    const SlowModem modem(sample, {one, first, second, plain});

    EXPECT_TRUE(alone.shows(" packets"));
    EXPECT_TRUE(both.shows(" packets"));
    EXPECT_EQ(alone.wait(), 0);
    EXPECT_EQ(both.wait(), 0);
    EXPECT_EQ(noTerminal.wait(), 0);

    EXPECT_EQ(alone.bytes().find('\n'), std::string::npos) << "one line, rewritten";
    EXPECT_GT(std::count(alone.bytes().begin(), alone.bytes().end(), '\r'), 3);
    EXPECT_TRUE(alone.bytes().ends_with(" \r"));
    const std::string screen = alone.screen().text();
    EXPECT_EQ(screen.find_first_not_of('\n'), std::string::npos) << screen;
    EXPECT_TRUE(contentOf(nothing).starts_with("{\""));

    EXPECT_EQ(both.screen().text().find(" packets"), std::string::npos) << "then cleared";
    EXPECT_NE(both.bytes().find("\r{\"tick\":1,"), std::string::npos);
    EXPECT_EQ(noTerminal.err(), "");
}

TEST_F(EndToEndProgress, OfAFileIsTheShareOfItsBytes) {
    const std::string drive = world.path("drive.pcap");
    const std::string written = world.path("written");
    ASSERT_EQ(run({"simulate", "lte", "--seconds", "60", "-o", drive}).status, 0);
    const std::string shown = world.path("shown");
    // A slow reader of the output slows the reading of the file.
    const std::string slowly =
        "{ until [ -e " + shown + " ]; do head -c 100000; sleep 0.2; done; cat; }";
    PallaxTerminal terminal(world,
                            {"-c", doubles::programPath() + " decode --every packet " + drive +
                                       " | " + slowly + " >" + written},
                            {.program = "/bin/sh"});
    EXPECT_TRUE(terminal.shows("#"));
    std::ofstream{shown};
    EXPECT_EQ(terminal.wait(), 0);
    const std::string screen = terminal.screen().text();
    EXPECT_EQ(screen.find_first_not_of('\n'), std::string::npos) << screen;
    EXPECT_TRUE(contentOf(written).starts_with("{\"packet\":1,"));
}

TEST_F(EndToEndProgress, OfASimulationIsTheShareOfItsTime) {
    const std::string counted = world.path("counted");
    PallaxTerminal terminal(world,
                            {"-c", doubles::programPath() +
                                       " simulate lte --seconds 3600 -o - | { sleep 3; wc -c >" +
                                       counted + "; }"},
                            {.program = "/bin/sh"});
    EXPECT_TRUE(terminal.shows(" %"));
    EXPECT_EQ(terminal.wait(), 0);
    const std::string screen = terminal.screen().text();
    EXPECT_EQ(screen.find_first_not_of('\n'), std::string::npos) << screen;
}

TEST_F(EndToEndProgress, ARunThatIsOverSoonShowsNone) {
    PallaxTerminal terminal(world,
                            {"-c", doubles::programPath() + " decode --jobs 2 " + lteDrive() + " " +
                                       lteDrive() + " >/dev/null"},
                            {.program = "/bin/sh"});
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_EQ(terminal.bytes(), "");
}

} // namespace
} // namespace pallax
