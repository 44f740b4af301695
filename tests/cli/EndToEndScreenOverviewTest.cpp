#include "tests/cli/EndToEndScreen.h"

#include <fstream>

namespace pallax {
namespace {

TEST_F(EndToEndScreen, TheOverviewShowsTheServingCellAndGoesBackToThePanes) {
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/list\r\r");
    ASSERT_TRUE(terminal.shows("Pallax › Neighbor Cells List"));
    terminal.type("o");
    ASSERT_TRUE(terminal.shows("Pallax › Overview"));
    EXPECT_TRUE(terminal.shows("Cell        eNodeB 104475 sector 1 · PCI 184 · TAC 6699"));
    EXPECT_TRUE(terminal.shows("EARFCN 1850 · band 3 · 1870.0 MHz"));
    EXPECT_TRUE(terminal.shows("RSRP  -92.75 dBm  excellent"));
    EXPECT_TRUE(terminal.shows("Events      22:15:19  serving cell 286 → 184 after 4 s"));
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.shows("Pallax › Neighbor Cells List"));
    terminal.type("qoqq");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
    EXPECT_EQ(terminal.screen().unknown(), "");
    expectHomeScreenPreference();
    expectNothingLeft();
}

TEST_F(EndToEndScreen, TheOverviewOfAnAsciiTerminalIsAscii) {
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {.locale = "C"});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("o");
    ASSERT_TRUE(terminal.shows("Pallax > Overview"));
    EXPECT_TRUE(terminal.shows("RSRP  -92.75 dBm  excellent  ####...."));
    EXPECT_TRUE(terminal.shows("serving cell 286 -> 184 after 4 s"));
    for (const char character : terminal.settled()) {
        EXPECT_EQ(static_cast<unsigned char>(character) & 0x80U, 0U);
    }
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, TheOverviewFollowsTheModelAfterAFreshStart) {
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("oR");
    EXPECT_TRUE(terminal.showsNoMore("End of the recording"));
    EXPECT_TRUE(terminal.shows("End of the recording"));
    EXPECT_TRUE(terminal.shows("PCI 184 · TAC 6699"));
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, TheOverviewIsTheFirstScreenIfTheSettingsSaySo) {
    std::ofstream(world.path("config/pallax/pallax.conf")) << "first-screen = overview\n";
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("Pallax › Overview"));
    EXPECT_TRUE(terminal.shows("PCI 184 · TAC 6699"));
    terminal.type("o");
    EXPECT_TRUE(terminal.shows("▌Serving Cell Info"));
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, ListsAreTablesIfTheSettingsSaySo) {
    std::ofstream(world.path("config/pallax/pallax.conf")) << "lists = table\n";
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/list\r\r");
    ASSERT_TRUE(terminal.shows("Pallax › Neighbor Cells List"));
    EXPECT_TRUE(terminal.shows("2 cells"));
    EXPECT_TRUE(terminal.shows("▌     184    -64.00"));
    terminal.type("t");
    EXPECT_TRUE(terminal.shows("▌0"));
    terminal.type("tq");
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, QueriesShareTheirHistoryWithTheShellOfSql) {
    std::filesystem::create_directories(world.path("state/pallax"));
    const std::string history = world.path("state/pallax/sql-history");
    std::ofstream(history) << "select 7 from packet;\n.tables\n";
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type(";");
    ASSERT_TRUE(terminal.shows("Pallax › Query"));
    terminal.type("\x1b[A");
    EXPECT_TRUE(terminal.shows(" ; select 7 from packet;")) << "and no command of the shell";
    terminal.type("\x15select 8\r");
    EXPECT_TRUE(doubles::eventually([&history] {
        return contentOf(history) == "select 7 from packet;\n.tables\nselect 8;\n";
    })) << contentOf(history);
    terminal.type(kEscape);
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.shows("▌Serving Cell Info"));
    terminal.type("e");
    EXPECT_TRUE(terminal.shows("Pallax › Events"));
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, LevelsAreJudgedByTheProfileOfTheSettingsOrTheOption) {
    std::ofstream(world.path("config/pallax/pallax.conf"))
        << "first-screen = overview\nprofile = field\n";
    PallaxTerminal field(world, {lteDrive(), "--speed", "max"}, {});
    EXPECT_TRUE(field.shows("quality by the profile field"));
    field.type("qq");
    EXPECT_EQ(field.wait(), 0);
    PallaxTerminal other(world, {lteDrive(), "--speed", "max", "--profile", "operator"}, {});
    EXPECT_TRUE(other.shows("quality by the profile operator"));
    other.type("o/cell meas\r\r/measured rsrp\r\r");
    EXPECT_TRUE(other.shows("operator: poor -110, fair -95"));
    other.type("qqq");
    EXPECT_EQ(other.wait(), 0);
}

TEST_F(EndToEndScreen, AProfileThatIsMissingEndsTheProgram) {
    const Run wrong = run({lteDrive(), "--print", "--profile", "nobody"});
    EXPECT_EQ(wrong.status, 2);
    EXPECT_EQ(wrong.out, "");
    EXPECT_NE(wrong.err.find("nobody"), std::string::npos) << wrong.err;
    std::ofstream(world.path("config/pallax/pallax.conf")) << "profile = nobody\n";
    const Run set = run({lteDrive(), "--print"});
    EXPECT_EQ(set.status, 1);
    EXPECT_EQ(set.err, wrong.err);
}

TEST_F(EndToEndScreen, AValueWithoutALabelIsOutOfRange) {
    constexpr unsigned kNoState = 99;
    PallaxTerminal terminal(
        world,
        {record("odd.pcap", {{std::chrono::milliseconds(0), registration(kNoState)}}), "--speed",
         "max"},
        {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/process co\r\r");
    EXPECT_TRUE(terminal.shows("out of range  Unknown"));
    terminal.type("/unknown\r\r");
    EXPECT_TRUE(terminal.shows("Unknown  out of range"));
    terminal.type("qqq");
    EXPECT_EQ(terminal.wait(), 0);
}

} // namespace
} // namespace pallax
