#include "tests/ui/pages/SampleDisplay.h"
#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax::terminal {
namespace {

Dictionary cell(const char* code, const char* level) {
    return Dictionary{{"RSRP", level}, {"PCI", code}, {"Paths", Array{"1", "2"}}};
}

/// A section, and a list of cells with these entries.
PropertyList displayOf(const Array& cells) {
    return Dictionary{{"Cells", cells}, {"SIM Info", Dictionary{{"IMSI", "001010123456789"}}}};
}

Array threeCells(const char* level = "-91.50 dBm") {
    return {cell("252", level), cell("184", "-104.00 dBm"), cell("9", "-88.00 dBm")};
}

class FrontEndTableTest : public StageFixture {
protected:
    FrontEndTableTest() {
        stage.entryPart = [](const std::string& path) {
            return path == "/Cells/*/PCI" ? EntryPart::Cell : EntryPart::None;
        };
        stage.tick(displayOf(threeCells()));
    }
    void openTable() {
        stage.press(Key::Enter);
        stage.type("t");
    }
    bool isTable() { return stage.screen(60, 9).find("PCI  RSRP dBm") != std::string::npos; }
    /// The row with the cursor, without its mark.
    std::string cursorRow() {
        for (const std::string& line : stage.frontEnd.draw().lines()) {
            if (line.starts_with("▌")) {
                return line.substr(std::string("▌").size());
            }
        }
        return "(none)";
    }
};

TEST_F(FrontEndTableTest, TSwitchesBetweenRowsAndATable) {
    stage.press(Key::Enter);
    EXPECT_EQ(stage.screen(60, 9), R"(
 Pallax › Cells
 ──────────────────────────────────────────────────────────
▌0                                                         ›
 1                                                         ›
 2                                                         ›


 ──────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20    / filter  s Save  ? help
)");
    stage.type("t");
    EXPECT_EQ(stage.screen(90, 9), R"(
 Pallax › Cells                                                                   3 cells
 ────────────────────────────────────────────────────────────────────────────────────────
 PCI  RSRP dBm  Paths
▌252    -91.50      2›
 184   -104.00      2›
   9    -88.00      2›

 ────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20     < > sort  r reverse  t rows  / filter  s Save  ? help
)");
    stage.type("t");
    EXPECT_FALSE(isTable());
}

TEST_F(FrontEndTableTest, AnAsciiTerminalGetsAsciiMarks) {
    TerminalStage ascii(kAsciiMarks);
    ascii.frontEnd.showListsAsTables(true);
    ascii.tick(displayOf(threeCells()));
    ascii.press(Key::Enter);
    (void)ascii.screen();
    ascii.tick(displayOf(threeCells("-89.00 dBm")));
    ascii.type(">");
    EXPECT_EQ(ascii.screen(40, 10), R"(
 Pallax > Cells               3 entries
 --------------------------------------
    RSRP
     dBm^ PCI  Paths
 -104.00  184      2>
> -89.00* 252      2>
  -88.00    9      2>

 --------------------------------------
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

TEST_F(FrontEndTableTest, RowsOfferTheTable) {
    stage.press(Key::Enter);
    stage.frontEnd.resize(80, 9);
    EXPECT_EQ(stage.line(8),
              " Updated 2023-11-14 at 22:13:20               t table  / filter  s Save  ? help");
}

TEST_F(FrontEndTableTest, TheSettingOpensListsAsTablesAndTheUsersChoiceHoldsForOthers) {
    stage.frontEnd.showListsAsTables(true);
    stage.press(Key::Enter);
    EXPECT_TRUE(isTable());
    stage.type("t");
    stage.press(Key::Left);
    stage.press(Key::Enter);
    EXPECT_FALSE(isTable());
}

TEST_F(FrontEndTableTest, OnlyAListHasATable) {
    const std::string before = stage.screen(60, 12);
    const int displays = stage.displays;
    stage.type("<>rxX");
    EXPECT_EQ(stage.displays, displays);
    EXPECT_EQ(stage.screen(), before);
    stage.type("t");
    EXPECT_NE(stage.screen().find("Nothing to show as a table: choose a list."), std::string::npos);
    stage.press(Key::Enter);
    const int rows = stage.displays;
    stage.type("<>rxX"); // rows have no columns
    EXPECT_EQ(stage.displays, rows);
}

TEST_F(FrontEndTableTest, EnterRightLAndAClickOpenTheEntry) {
    openTable();
    stage.type(">"); // by PCI: 9, 184, 252
    stage.press(Key::Home);
    for (const auto& open : {KeyEvent{.key = Key::Enter}, KeyEvent{.key = Key::Right}, typed(U'l'),
                             KeyEvent{.key = Key::Click, .x = 5, .y = 4}}) {
        (void)stage.screen(60, 12);
        stage.frontEnd.handle(open);
        EXPECT_EQ(stage.line(0), " Pallax › Cells › 2");
        stage.press(Key::Left);
        EXPECT_EQ(cursorRow(), "  9   -88.00      2›");
    }
    stage.type("h");
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndTableTest, RightScrollsBeforeItOpens) {
    openTable();
    (void)stage.screen(20, 9);
    stage.press(Key::Right);
    EXPECT_EQ(stage.depth(), 2U);
    EXPECT_EQ(stage.line(2), " PCI  Paths");
    stage.type("l");
    EXPECT_EQ(stage.depth(), 3U);
    stage.press(Key::Left);
    stage.press(Key::Left);
    EXPECT_EQ(stage.depth(), 2U);
    EXPECT_EQ(stage.line(2), " PCI  RSRP dBm     …");
    stage.press(Key::Left);
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndTableTest, TheCursorFollowsTheCellAndChangesAreMarked) {
    openTable();
    (void)stage.screen(60, 12);
    stage.press(Key::Down);
    EXPECT_EQ(cursorRow(), "184  -104.00      2›");
    stage.tick(displayOf(
        {cell("184", "-103.00 dBm"), cell("252", "-91.50 dBm"), cell("7", "-99.00 dBm")}));
    EXPECT_EQ(stage.screen(60, 9), R"(
 Pallax › Cells                                     3 cells
 ──────────────────────────────────────────────────────────
 PCI  RSRP dBm  Paths
▌184   -103.00*     2›
 252    -91.50      2›
   7*   -99.00*     2*

 ──────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20    / filter  s Save  ? help
)");
    stage.tick(displayOf({}));
    EXPECT_EQ(cursorRow(), "(none)");
    stage.tick(displayOf({cell("252", "-91.50 dBm"), cell("184", "-103.00 dBm")}));
    EXPECT_EQ(cursorRow(), "184*  -103.00*     2*");
}

TEST_F(FrontEndTableTest, NothingIsMarkedThatChangedWhileRowsWereShown) {
    openTable();
    stage.type("t");
    stage.tick(displayOf(threeCells("-70.00 dBm")));
    stage.type("t");
    EXPECT_EQ(stage.screen(60, 12).find("*"), std::string::npos);
    stage.tick(displayOf(threeCells("-71.00 dBm")));
    EXPECT_NE(stage.screen(60, 12).find("-71.00*"), std::string::npos);
}

TEST_F(FrontEndTableTest, TheCursorStaysOnItsEntryWhenTheLookChanges) {
    stage.press(Key::Enter);
    stage.press(Key::Down);
    stage.type("t");
    (void)stage.screen(60, 12);
    EXPECT_EQ(cursorRow(), "184  -104.00      2›");
    stage.type(">");
    stage.press(Key::Home); // PCI 9
    stage.type("t");
    EXPECT_EQ(stage.cursorName(), "2");
}

TEST_F(FrontEndTableTest, KeysAndTheWheelMoveTheCursor) {
    openTable();
    (void)stage.screen(60, 12);
    stage.type("G");
    EXPECT_EQ(cursorRow(), "  9   -88.00      2›");
    stage.type("kk");
    EXPECT_EQ(cursorRow(), "252   -91.50      2›");
    stage.mouse(Key::WheelDown, 0, 0);
    EXPECT_EQ(cursorRow(), "  9   -88.00      2›");
    stage.press(Key::PageUp);
    EXPECT_EQ(cursorRow(), "252   -91.50      2›");
}

TEST_F(FrontEndTableTest, AClickOnAHeadingSorts) {
    openTable();
    (void)stage.screen(60, 12);
    stage.click(8, 2);
    EXPECT_EQ(stage.line(3), " PCI      dBm↑ Paths");
    EXPECT_EQ(stage.line(4), " 184  -104.00      2›");
}

TEST_F(FrontEndTableTest, TheFilterLooksIntoEveryCell) {
    openTable();
    stage.type("/-104");
    EXPECT_EQ(stage.screen(60, 9), R"(
 Pallax › Cells                                      1 of 3
 ──────────────────────────────────────────────────────────
 PCI  RSRP dBm  Paths
▌184   -104.00      2›



 ──────────────────────────────────────────────────────────
 / -104                                    Esc clear filter
)");
    stage.press(Key::Enter);
    stage.press(Key::Escape);
    EXPECT_EQ(stage.depth(), 2U);
    EXPECT_EQ(stage.line(0), " Pallax › Cells                                     3 cells");
    stage.type("/-104");
    stage.press(Key::Enter);
    stage.type("t");
    EXPECT_EQ(stage.pane().shownRows(), 3U) << "rows have a filter of their own";
}

TEST_F(FrontEndTableTest, YCopiesTheIdentityOrTheChosenValue) {
    openTable();
    stage.type("y>>y>y");
    EXPECT_EQ(stage.copied, (std::vector<std::string>{"252", "-91.50 dBm", "2"}));
    stage.entryPart = ListLook().partAt;
    stage.type("<<<y");
    EXPECT_EQ(stage.copied.back(), "252");
}

TEST_F(FrontEndTableTest, TheCountSaysWhatTheRowsAre) {
    stage.tick(displayOf({cell("252", "-91.50 dBm")}));
    openTable();
    (void)stage.screen(60, 9);
    EXPECT_EQ(stage.line(0), " Pallax › Cells                                      1 cell");
    stage.entryPart = ListLook().partAt;
    stage.tick(displayOf(threeCells()));
    EXPECT_EQ(stage.line(0), " Pallax › Cells                                   3 entries");
    stage.type("y");
    EXPECT_EQ(stage.copied.back(), "-91.50 dBm\t252\t2") << "without an identity, the row";
}

TEST_F(FrontEndTableTest, RowsOutsideTheWindowAreCountedInTheRules) {
    openTable();
    stage.press(Key::Down);
    EXPECT_EQ(stage.screen(30, 6), R"(
 Pallax › Cells       3 cells
 ────────────────────── ↑ 1 ─
 PCI  RSRP dBm  Paths
▌184   -104.00      2›
 ────────────────────── ↓ 1 ─
 …ated 2023-11-14 at 22:13:20
)");
}

} // namespace
} // namespace pallax::terminal
