#include "host/Recording.h"
#include "telephony/simulator/Simulation.h"
#include "tests/cli/EndToEnd.h"

#include <csignal>

// A service that simulates a modem for viewers and recorders alike.

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;

/// The end of the 20 simulated seconds that each of them is given.
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
    /// All that a viewer has printed until after the last tick.
    std::string shownBy(PallaxProcess& viewer) {
        EXPECT_TRUE(viewer.says(kLastTick));
        std::string shown;
        EXPECT_TRUE(eventually([&] { // the rest of the tick may be on its way
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
    /// A recording's ticks as the viewer prints them.
    std::string printed(const std::string& recording) {
        const Run played = run({recording, "--print", "--speed", "max"});
        EXPECT_EQ(played.status, 0) << played.err;
        EXPECT_GT(played.out.size(), 5000U);
        return played.out;
    }
};

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
