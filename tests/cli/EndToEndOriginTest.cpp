#include "tests/cli/EndToEndScreen.h"

#include <csignal>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;

/// The origin of the values on the screen, and starting afresh.
class EndToEndOrigin : public EndToEndScreen {
protected:
    static std::vector<std::string> serviceOf(const std::string& technology) {
        return {"service", "--simulate", technology, "--seed", "5", "--speed", "4"};
    }
    bool serviceIsThere() const {
        return eventually([this] { return !world.sockets().empty(); });
    }
    static void end(PallaxProcess& process) {
        process.signal(SIGTERM);
        EXPECT_EQ(process.wait(), 0) << process.err();
    }
    static void quit(PallaxTerminal& terminal) {
        terminal.signal(SIGTERM);
        EXPECT_EQ(terminal.wait(), 0);
        EXPECT_TRUE(terminal.isRestored());
    }
    /// Shows values of an LTE modem, then changes the service to GSM.
    void becomeGsm(PallaxTerminal& terminal) {
        PallaxProcess lte(world, serviceOf("lte"));
        ASSERT_TRUE(serviceIsThere());
        ASSERT_TRUE(terminal.shows("Neighbor Cells List"));
        ASSERT_TRUE(terminal.shows("Zorell_LTE · live modem"));
        end(lte);
        gsm = std::make_unique<PallaxProcess>(world, serviceOf("gsm"));
    }

    std::unique_ptr<PallaxProcess> gsm;
};

TEST_F(EndToEndOrigin, TheTitleNamesTechnologyAndSourceAndTheTimeItsZone) {
    world.environment = {"TZ=EST5"};
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    EXPECT_TRUE(terminal.shows(
        "Pallax                                             Zorell_LTE · lte-drive.pcap\n"));
    EXPECT_TRUE(terminal.shows(" -0500  End of the recording"));
    terminal.resize(40, 20);
    EXPECT_TRUE(terminal.shows("Pallax     Zorell_LTE · lte-drive.pcap\n"));
    quit(terminal);

    PallaxTerminal demo(world, {"demo", "utran"}, {});
    EXPECT_TRUE(demo.shows("Zorell_UTRAN2 · simulated utran\n"));
    quit(demo);

    PallaxTerminal live(world, {}, {});
    EXPECT_TRUE(live.shows(" live modem\n"));
    quit(live);
}

TEST_F(EndToEndOrigin, AfterAReconnectOldValuesAreToldAndRStartsAfresh) {
    PallaxTerminal terminal(world, {}, {});
    becomeGsm(terminal);
    ASSERT_TRUE(terminal.shows("Zorell_GSM · live modem"));
    EXPECT_TRUE(terminal.shows(" values from before 22:1")); // a time of the simulation
    EXPECT_TRUE(terminal.shows(": press R to start afresh "));
    EXPECT_TRUE(terminal.shows("Neighbor Cells List")) << "the display keeps its last values";
    terminal.resize(40, 20);
    EXPECT_TRUE(terminal.shows(": R renews"));
    terminal.type("/list\r\r"); // R is pressed in a deep pane
    ASSERT_TRUE(terminal.shows("Pallax › Neighbor Cells List\n"));
    terminal.resize(80, 24);
    terminal.type("R");
    EXPECT_TRUE(terminal.shows("Equivalent PLMN List")); // the first pane keeps its filter
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.shows("Serving PLMN"));
    EXPECT_TRUE(terminal.showsNoMore("values from before"));
    EXPECT_TRUE(terminal.showsNoMore("Neighbor Cells List"));
    EXPECT_TRUE(terminal.shows("Zorell_GSM · live modem"));
    quit(terminal);
    end(*gsm);
    expectNothingLeft();
}

TEST_F(EndToEndOrigin, WithTheSettingItStartsAfreshByItself) {
    std::ofstream(world.path("config/pallax/pallax.conf"), std::ios::app)
        << "after-reconnect = fresh\n";
    PallaxTerminal terminal(world, {}, {});
    becomeGsm(terminal);
    terminal.type("s"); // works with the snapshot screen open
    ASSERT_TRUE(terminal.shows("Save snapshot"));
    EXPECT_TRUE(terminal.shows("Zorell_GSM · live modem"));
    terminal.type("of LTE\r\r");
    EXPECT_TRUE(terminal.shows("Serving PLMN"));
    EXPECT_TRUE(terminal.showsNoMore("Neighbor Cells List"));
    EXPECT_EQ(terminal.screen().text().find("values from before"), std::string::npos);
    ASSERT_EQ(filesIn(snapshots).size(), 1U);
    EXPECT_NE(contentOf(filesIn(snapshots)[0]).find("Neighbor Cells List"), std::string::npos);
    quit(terminal);
    end(*gsm);
}

TEST_F(EndToEndOrigin, RPlaysARecordingAgainButStandardInputOnlyOnce) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    const std::size_t before = terminal.bytes().size();
    terminal.type("R");
    EXPECT_TRUE(eventually([&] {
        (void)terminal.settled();
        return terminal.bytes().find("Connecting", before) != std::string::npos;
    }));
    EXPECT_TRUE(terminal.shows("End of the recording"));
    quit(terminal);

    const std::string command = doubles::programPath() + " - --speed max < " + brief();
    PallaxTerminal piped(world, {"-c", command}, {.program = "/bin/sh"});
    ASSERT_TRUE(piped.shows("End of the recording"));
    EXPECT_TRUE(piped.shows("Zorell_GSM · standard input"));
    piped.type("R");
    EXPECT_TRUE(piped.shows("A stream can be played only once"));
    piped.type("q");
    EXPECT_EQ(piped.wait(), 0);
}

} // namespace
} // namespace pallax
