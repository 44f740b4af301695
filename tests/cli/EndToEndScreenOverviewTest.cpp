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
    terminal.type("qoq");
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
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, TheOverviewFollowsTheModelAfterAFreshStart) {
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("oR");
    EXPECT_TRUE(terminal.showsNoMore("End of the recording"));
    EXPECT_TRUE(terminal.shows("End of the recording"));
    EXPECT_TRUE(terminal.shows("PCI 184 · TAC 6699"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, TheOverviewIsTheFirstScreenIfTheSettingsSaySo) {
    std::ofstream(world.path("config/pallax/pallax.conf")) << "first-screen = overview\n";
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("Pallax › Overview"));
    EXPECT_TRUE(terminal.shows("PCI 184 · TAC 6699"));
    terminal.type("o");
    EXPECT_TRUE(terminal.shows("▌Serving Cell Info"));
    terminal.type("q");
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
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

} // namespace
} // namespace pallax
