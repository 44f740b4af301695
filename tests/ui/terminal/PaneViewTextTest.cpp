#include "tests/ui/terminal/StageFixture.h"
#include "ui/terminal/PaneView.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {
namespace {

using PaneViewTextTest = StageFixture;

TEST_F(PaneViewTextTest, ALongRowEndsInAMarkAndScrollsSideways) {
    openSection({{"A name of 22 columns..", "a value of twenty-five..."}, {"Next", "1"}});
    stage.frontEnd.resize(40, 12);
    EXPECT_EQ(stage.line(2), "▌A name of 22 columns..     a value o…");
    EXPECT_EQ(styleAt(37, 2), Style{.dim = true});
    stage.press(Key::Right);
    EXPECT_EQ(stage.line(2), "▌f 22 columns..     a value of twenty…");
    stage.press(Key::Right);
    EXPECT_EQ(stage.line(2), "▌umns..     a value of twenty-five...");
    EXPECT_EQ(stage.line(3), " Next                                1");
    stage.press(Key::Down);
    EXPECT_EQ(stage.line(2), " A name of 22 columns..     a value o…");
}

TEST_F(PaneViewTextTest, ARowThatJustFitsHasNoMark) {
    openSection({{"A name of 22 columns..", "ten......."}});
    stage.frontEnd.resize(40, 12);
    EXPECT_EQ(stage.line(2), "▌A name of 22 columns..     ten.......");
}

TEST_F(PaneViewTextTest, WideAndCombiningCharactersKeepColumnsStraight) {
    openSection({{"漢字", "値です"}, {"Cafe\u0301", "e\u0301e\u0301e\u0301"}, {"Plain", "value"}});
    EXPECT_EQ(stage.screen(40, 12), R"(
 Pallax › Section
 ──────────────────────────────────────
▌漢字                           値です
 Café                              ééé
 Plain                           value





 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
    const Grid grid = draw();
    EXPECT_EQ(faultOf(grid), "");
    // All values end in the same column.
    EXPECT_EQ(grid.at(36, 2).text, "す");
    EXPECT_EQ(grid.at(37, 2).text, "");
    EXPECT_EQ(grid.at(37, 3).text, "e\u0301");
    EXPECT_EQ(grid.at(37, 4).text, "e");
}

TEST_F(PaneViewTextTest, AWideCharacterCutAtEitherEdgeLeavesABlank) {
    openSection({{"漢字漢字漢字漢字漢字漢字漢字漢字漢字漢字", "値"},
                 {"x漢字漢字漢字漢字漢字漢字漢字漢字漢字", "値"}});
    stage.frontEnd.resize(20, 6);
    EXPECT_EQ(stage.line(2), "▌漢字漢字漢字漢字…");
    EXPECT_EQ(stage.line(3), " x漢字漢字漢字漢 …");
    EXPECT_EQ(faultOf(draw()), "");
    stage.press(Key::Down);
    stage.press(Key::Right);
    EXPECT_EQ(stage.line(3), "▌ 漢字漢字漢字漢 …");
    EXPECT_EQ(faultOf(draw()), "");
}

TEST_F(PaneViewTextTest, WhatAModemSendsNeverReachesTheScreenRaw) {
    openSection({{"Esc\x1b[2J", "\x07"
                                "bell"},
                 {"Broken \xff\xc3", "\xe6\xbc"},
                 {"C1 \u009b31m", "new\nline"},
                 {"Turned \u202e", "\u200f"}},
                "Odd\x1b]0;title\x07");
    EXPECT_EQ(stage.screen(40, 12), R"(
 Pallax › Odd\x1B]0;title\x07
 ──────────────────────────────────────
▌Esc\x1B[2J                   \x07bell
 Broken ��                          ��
 C1 \u009B31m              new\x0Aline
 Turned \u202E                  \u200F




 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
    EXPECT_EQ(faultOf(draw()), "");
}

TEST_F(PaneViewTextTest, WithAsciiMarksAnAsciiDisplayIsAsciiOnly) {
    TerminalStage ascii(kAsciiMarks);
    ascii.saveHistory = snapshotItems();
    ascii.frontEnd.resize(40, 12);
    std::string screens = ascii.screen();
    ascii.tick(display());
    screens += ascii.screen();
    ascii.press(Key::Enter);
    ascii.tick(display("-99.00 dBm"));
    EXPECT_EQ(ascii.screen(), R"(
 Pallax > Serving Cell Measurements
 --------------------------------------
>Version                             1
 E-ARFCN                          1850
 Physical Cell ID                  274
 Measured RSRP              -99.00 dBm *
 Average RSRP               -95.00 dBm
 Measured RSRQ                -9.50 dB


 --------------------------------------
 Updated 2023-11-14 at 22:13:20  ? help
)");
    screens += ascii.screen() + ascii.screen(20, 5);
    ascii.type("?");
    screens += ascii.screen();
    ascii.type("x/r");
    screens += ascii.screen();
    ascii.press(Key::Enter);
    ascii.type("s");
    screens += ascii.screen() + ascii.screen(80, 24);
    ascii.frontEnd.toolkit().showAlert({"Title", "Message", "Close"});
    screens += ascii.screen() + ascii.screen(19, 5);
    for (int turn = 0; turn < 4; ++turn) {
        ascii.frontEnd.turn();
        screens += ascii.screen();
    }
    EXPECT_TRUE(std::all_of(screens.begin(), screens.end(), [](char byte) { return byte >= 0; }))
        << screens;
}

TEST_F(PaneViewTextTest, TheAsciiMarksAreAsciiAndEveryMarkIsOneColumnWide) {
    for (const Marks& marks : {kUtf8Marks, kAsciiMarks}) {
        std::vector<std::string_view> all{marks.cursor,     marks.disclosure, marks.changed,
                                          marks.more,       marks.check,      marks.horizontal,
                                          marks.vertical,   marks.topLeft,    marks.topRight,
                                          marks.bottomLeft, marks.bottomRight};
        all.insert(all.end(), marks.spinner.begin(), marks.spinner.end());
        for (const std::string_view mark : all) {
            EXPECT_EQ(columnsOf(mark), 1) << mark;
            EXPECT_TRUE(!marks.asciiOnly || mark.front() > ' ') << mark;
        }
    }
    EXPECT_EQ(kUtf8Marks.crumb, " › ");
    EXPECT_EQ(kAsciiMarks.crumb, " > ");
}

} // namespace
} // namespace pallax::terminal
