#include "host/Recording.h"
#include "simulator/Simulation.h"
#include "tests/cli/EndToEnd.h"

#include <csignal>
#include <filesystem>
#include <fstream>
#include <set>
#include <sstream>

// A service that simulates a modem for viewers and recorders.

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;

/// The end of the 20 simulated seconds that each client receives.
constexpr const char* kLastTick = "== 2023-11-14 22:13:40 +0000\n";

class EndToEndSimulatedService : public EndToEnd {
protected:
    std::vector<std::string> service(const std::string& technology, const std::string& speed) {
        return {"service", "--simulate", technology, "--seed",  "5",  "--rate",
                "20",      "--seconds",  "20",       "--speed", speed};
    }
    bool serviceIsThere() const {
        return eventually([this] { return !world.sockets().empty(); });
    }
    /// The viewer's output until after the last tick.
    std::string shownBy(PallaxProcess& viewer) {
        EXPECT_TRUE(viewer.says(kLastTick));
        std::string shown;
        EXPECT_TRUE(eventually([&] { // the end of the tick may follow later
            const bool isWhole = shown == viewer.out();
            shown = viewer.out();
            return isWhole;
        }));
        end(viewer);
        return viewer.out();
    }
    void end(PallaxProcess& process) {
        process.signal(SIGTERM);
        EXPECT_EQ(process.wait(), 0) << process.err();
    }
    /// A recording's ticks in the viewer's format.
    std::string printed(const std::string& recording) {
        const Run played = run({recording, "--print", "--speed", "max"});
        EXPECT_EQ(played.status, 0) << played.err;
        EXPECT_GT(played.out.size(), 5000U);
        return played.out;
    }
};

/// The inode numbers of a process's open sockets.
std::vector<std::string> socketsOf(pid_t process) {
    std::vector<std::string> numbers;
    const std::string folder = "/proc/" + std::to_string(process) + "/fd";
    for (const auto& each : std::filesystem::directory_iterator(folder)) {
        std::error_code gone;
        const std::string target = std::filesystem::read_symlink(each.path(), gone);
        constexpr std::string_view kSocket = "socket:[";
        if (target.starts_with(kSocket)) {
            numbers.push_back(target.substr(kSocket.size(), target.size() - kSocket.size() - 1));
        }
    }
    return numbers;
}

TEST_F(EndToEndSimulatedService, ARecordingOfEachModemShowsTickByTickWhatTheViewerShowed) {
    for (const RecordedTechnology* each : simulatedTechnologies()) {
        SCOPED_TRACE(each->commandName);
        const std::string technology(each->commandName);
        PallaxProcess modem(world, service(technology, "max"));
        ASSERT_TRUE(serviceIsThere());
        const std::string file = world.path(technology + ".pcapng");
        PallaxProcess viewer(world, {"--print"});
        PallaxProcess recorder(world, {"record", file});
        EXPECT_EQ(recorder.wait(), 0) << recorder.err();
        const std::string shown = shownBy(viewer);
        EXPECT_TRUE(shown == printed(file)) << shown;
        end(modem);
    }
}

TEST_F(EndToEndSimulatedService, ASignalEndsItAndItsSocketsAreRemoved) {
    for (const int number : {SIGINT, SIGTERM}) {
        PallaxProcess modem(world, {"service", "--simulate", "lte"});
        ASSERT_TRUE(serviceIsThere());
        PallaxProcess viewer(world, {"--print"});
        EXPECT_TRUE(viewer.says("== "));
        modem.signal(number);
        EXPECT_EQ(modem.wait(), 0);
        EXPECT_EQ(modem.err(), "");
        end(viewer);
        EXPECT_EQ(world.sockets(), std::vector<std::string>());
    }
}

TEST_F(EndToEndSimulatedService, NobodyOpensASocketOfTheNetwork) {
    PallaxProcess modem(world, {"service", "--simulate", "lte"});
    ASSERT_TRUE(serviceIsThere());
    PallaxProcess viewer(world, {"--print"});
    PallaxProcess recorder(world, {"record", world.path("a.pcapng")});
    EXPECT_TRUE(viewer.says("== "));
    EXPECT_TRUE(eventually([this] { return std::filesystem::exists(world.path("a.pcapng")); }));
    for (const PallaxProcess* each : {&modem, &viewer, &recorder}) {
        // The seventh column is the socket's number.
        std::ifstream table("/proc/" + std::to_string(each->id()) + "/net/unix");
        std::set<std::string> local;
        for (std::string line; std::getline(table, line);) {
            std::istringstream columns(line);
            std::string column;
            for (int count = 0; count < 7; ++count) {
                columns >> column;
            }
            local.insert(column);
        }
        const auto open = socketsOf(each->id());
        EXPECT_GE(open.size(), 2U) << "one listens, one is connected";
        for (const std::string& number : open) {
            EXPECT_TRUE(local.contains(number)) << "socket " << number;
        }
    }
    end(viewer);
    end(recorder);
    end(modem);
}

TEST_F(EndToEndSimulatedService, SoItIsWhenThePacketsComeInTheirTime) {
    for (const std::string technology : {"lte", "ifx"}) {
        SCOPED_TRACE(technology);
        PallaxProcess modem(world, service(technology, "12"));
        ASSERT_TRUE(serviceIsThere());
        const std::string file = world.path(technology + ".pcapng");
        PallaxProcess recorder(world, {"record", file});
        PallaxProcess viewer(world, {"--print"});
        const std::string shown = shownBy(viewer);
        EXPECT_EQ(recorder.wait(), 0) << recorder.err();
        EXPECT_TRUE(shown == printed(file)) << shown;
        end(modem);
    }
}

TEST_F(EndToEndSimulatedService, ARecordingDecodesLikeTheSimulationThatWasWritten) {
    PallaxProcess modem(world, service("lte", "max"));
    ASSERT_TRUE(serviceIsThere());
    const std::string recorded = world.path("recorded.pcapng");
    const std::string written = world.path("written.pcap");
    ASSERT_EQ(run({"record", recorded}).status, 0);
    ASSERT_EQ(
        run({"simulate", "lte", "--seed", "5", "--rate", "20", "--seconds", "20", "-o", written})
            .status,
        0);
    const Run ofRecorded = run({"decode", "--every", "packet", recorded});
    EXPECT_EQ(ofRecorded.status, 0);
    EXPECT_GT(ofRecorded.out.size(), 100000U);
    EXPECT_TRUE(ofRecorded.out == run({"decode", "--every", "packet", written}).out);
    end(modem);
}

} // namespace
} // namespace pallax
