#include "tests/cli/EndToEndScreen.h"

#include <fstream>
#include <optional>
#include <string>
#include <vector>

namespace pallax {
namespace {

/// What an engineer looks up in a recording, and how many keys each answer takes. A line that is
/// typed after ":" or "f" counts as one key.
class EndToEndScreenSession : public EndToEndScreen {
protected:
    void open(const std::string& recording, const std::string& settings) {
        std::ofstream(world.path("config/pallax/pallax.conf")) << settings;
        terminal.emplace(world, std::vector<std::string>{recording, "--speed", "max"},
                         PallaxTerminal::Setup{});
        ASSERT_TRUE(terminal->shows("End of the recording"));
        keys = 0;
    }
    void press(const std::string& key) {
        terminal->type(key);
        ++keys;
    }
    void goTo(const std::string& place) { press(":" + place + "\r"); }
    void quit() {
        terminal->type("qqqq");
        EXPECT_EQ(terminal->wait(), 0);
        EXPECT_TRUE(terminal->isRestored());
        EXPECT_EQ(terminal->screen().unknown(), "");
    }

    std::optional<PallaxTerminal> terminal;
    int keys = 0;
};

TEST_F(EndToEndScreenSession, TheCellAndItsQualityTakeNoKey) {
    open(lteDrive(), "first-screen = overview\n");
    EXPECT_TRUE(terminal->shows("Cell        eNodeB 104475 sector 1 · PCI 184 · TAC 6699"));
    EXPECT_TRUE(terminal->shows("RSRP  -92.75 dBm  excellent"));
    EXPECT_EQ(keys, 0);
    quit();
}

TEST_F(EndToEndScreenSession, TheNeighboursTakeThreeKeysFromAnyPane) {
    open(lteDrive(), "lists = table\n");
    press("fneighbor cells list");
    ASSERT_TRUE(terminal->shows("Find in this frame"));
    ASSERT_TRUE(terminal->shows("▌Neighbor Cells List"));
    press("\r");
    EXPECT_TRUE(terminal->shows("▌Neighbor Cells List")) << "the cursor is on the section";
    press("\r");
    EXPECT_TRUE(terminal->shows("2 cells"));
    EXPECT_TRUE(terminal->shows("▌     184    -64.00"));
    EXPECT_EQ(keys, 3);
    quit();
}

TEST_F(EndToEndScreenSession, AListBecomesATableByOneKey) {
    open(lteDrive(), "");
    terminal->type("/neighbor cells list\r\r");
    ASSERT_TRUE(terminal->shows("Pallax › Neighbor Cells List"));
    keys = 0;
    press("t");
    EXPECT_TRUE(terminal->shows("▌     184    -64.00"));
    EXPECT_EQ(keys, 1);
    quit();
}

TEST_F(EndToEndScreenSession, TheCurveOfALevelTakesTwoKeysFromASearch) {
    open(lteDrive(), "");
    terminal->type("fmeasured rsrp");
    ASSERT_TRUE(terminal->shows("Find in this frame"));
    keys = 0;
    press("\r");
    ASSERT_TRUE(terminal->shows("▌Measured RSRP"));
    press("i");
    EXPECT_TRUE(terminal->shows("the last 5 minutes"));
    EXPECT_EQ(keys, 2);
    quit();
}

TEST_F(EndToEndScreenSession, WhatChangedSinceAnInstantTakesFourKeys) {
    open(lteDrive(), "");
    goTo("22:14");
    ASSERT_TRUE(terminal->shows("held, "));
    press("m");
    press("$");
    ASSERT_TRUE(terminal->showsNoMore("held, "));
    press("d");
    EXPECT_TRUE(terminal->shows("Changes from 22:14:00 to 22:15:"));
    EXPECT_TRUE(terminal->shows("Physical Cell ID"));
    EXPECT_EQ(keys, 4);
    quit();
}

TEST_F(EndToEndScreenSession, AStateIsReachedByACondition) {
    const std::string drive = world.path("utran.pcap");
    ASSERT_EQ(run({"simulate", "utran", "--seed", "7", "--seconds", "60", "-o", drive}).status, 0);
    open(drive, "");
    press("^");
    goTo("state = 'Cell DCH'");
    ASSERT_TRUE(terminal->shows("22:13:30"));
    EXPECT_EQ(keys, 2) << "the search goes forwards, so it begins at the start";
    quit();
}

TEST_F(EndToEndScreenSession, AWordIsFoundInTheWholeRecording) {
    const std::string drive = world.path("utran.pcap");
    ASSERT_EQ(run({"simulate", "utran", "--seed", "7", "--seconds", "60", "-o", drive}).status, 0);
    open(drive, "");
    terminal->type("f\tcell dch");
    ASSERT_TRUE(terminal->shows("Find in the whole recording"));
    ASSERT_TRUE(terminal->shows("Cell DCH"));
    terminal->type("\r");
    EXPECT_TRUE(terminal->shows("held, "));
    EXPECT_TRUE(terminal->shows("22:13:30"));
    terminal->type("n");
    EXPECT_TRUE(terminal->showsNoMore("22:13:30"));
    quit();
}

} // namespace
} // namespace pallax
