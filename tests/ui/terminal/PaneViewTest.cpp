#include "ui/terminal/PaneView.h"

#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

namespace pallax::terminal {
namespace {

using PaneViewTest = StageFixture;

TEST_F(PaneViewTest, APaneWithoutDataIsEmptyAboveASpinner) {
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax
 ──────────────────────────────────────────────────────────────────────────────




















 ──────────────────────────────────────────────────────────────────────────────
 ⠋ Connecting                                                    s Save  ? help
)");
    EXPECT_EQ(stage.screen(40, 12), R"(
 Pallax
 ──────────────────────────────────────








 ──────────────────────────────────────
 ⠋ Connecting            s Save  ? help
)");
    EXPECT_EQ(stage.screen(20, 5), R"(
 Pallax
 ──────────────────

 ──────────────────
 ⠋ Connecting     ?
)");
}

TEST_F(PaneViewTest, TheRootPaneShowsBranchesWithMarksAndListsWithCounts) {
    stage.tick(display());
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax
 ──────────────────────────────────────────────────────────────────────────────
▌Serving Cell Measurements                                                     ›
 Measured Neighbor Cells                                                     3 ›
 Empty List                                                                    ›
 SIM Info                                                                      ›
 Operator                                                              Example















 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    EXPECT_EQ(stage.screen(40, 12), R"(
 Pallax
 ──────────────────────────────────────
▌Serving Cell Measurements             ›
 Measured Neighbor Cells             3 ›
 Empty List                            ›
 SIM Info                              ›
 Operator                      Example



 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
    EXPECT_EQ(stage.screen(20, 5), R"(
 Pallax
 ──────────────────
▌Serving Cell Mea… ›
 ──────────── ↓ 4 ─
 …11-14 at 22:13:20
)");
}

TEST_F(PaneViewTest, ASectionShowsNamesLeftAndValuesRight) {
    stage.tick(display());
    stage.press(Key::Enter);
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────────────────────────────────────────────────────
▌Version                                                                     1
 E-ARFCN                                                                  1850
 Physical Cell ID                                                          274
 Measured RSRP                                                      -94.75 dBm
 Average RSRP                                                       -95.00 dBm
 Measured RSRQ                                                        -9.50 dB














 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    EXPECT_EQ(stage.screen(40, 12), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────────────
▌Version                             1
 E-ARFCN                          1850
 Physical Cell ID                  274
 Measured RSRP              -94.75 dBm
 Average RSRP               -95.00 dBm
 Measured RSRQ                -9.50 dB


 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
    EXPECT_EQ(stage.screen(20, 5), R"(
 … › Serving Cell …
 ──────────────────
▌Version         1
 ──────────── ↓ 5 ─
 …11-14 at 22:13:20
)");
}

TEST_F(PaneViewTest, ALongNameEndsBeforeTheCountBehindIt) {
    stage.tick(Dictionary{{"Measured Neighbor Cells", Array{"a", "b", "c"}},
                          {"Sixteen Columns.", Array{"a", "b", "c"}},
                          {"Fifteen Columns", Array{"a", "b", "c"}}});
    EXPECT_EQ(stage.screen(20, 7), R"(
 Pallax
 ──────────────────
▌Measured Neigh… 3 ›
 Sixteen Column… 3 ›
 Fifteen Columns 3 ›
 ──────────────────
 …11-14 at 22:13:20
)");
}

TEST_F(PaneViewTest, MoreRowsThanRoomScrollWithTheCursor) {
    stage.tick(display());
    stage.press(Key::Enter);
    stage.frontEnd.resize(40, 7);
    stage.press(Key::End);
    EXPECT_EQ(stage.screen(), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────── ↑ 3 ─
 Measured RSRP              -94.75 dBm
 Average RSRP               -95.00 dBm
▌Measured RSRQ                -9.50 dB
 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

TEST_F(PaneViewTest, RowsAboveAndBelowTheWindowAreHintedAt) {
    stage.tick(display());
    stage.press(Key::Enter);
    stage.frontEnd.resize(40, 7);
    EXPECT_EQ(stage.line(1), " ──────────────────────────────────────");
    EXPECT_EQ(stage.line(5), " ──────────────────────────────── ↓ 3 ─");
    stage.press(Key::Down, 3);
    EXPECT_EQ(stage.screen(), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────── ↑ 1 ─
 E-ARFCN                          1850
 Physical Cell ID                  274
▌Measured RSRP              -94.75 dBm
 ──────────────────────────────── ↓ 2 ─
 Updated 2023-11-14 at 22:13:20  ? help
)");
    EXPECT_EQ(styleAt(34, 1), Style{});
    stage.click(34, 5);
    EXPECT_EQ(stage.cursorName(), "Measured RSRQ");
    stage.click(34, 1);
    EXPECT_EQ(stage.cursorName(), "Measured RSRP");
    stage.type("/measured");
    EXPECT_EQ(stage.line(1), " ──────────────────────────────────────")
        << "all matches are visible";
    EXPECT_EQ(stage.line(5), " ──────────────────────────────────────");
}

TEST_F(PaneViewTest, WhatIsWhereTellsItsStyle) {
    stage.tick(display());
    stage.frontEnd.resize(40, 12);
    const Grid grid = draw();
    EXPECT_EQ(grid.at(1, 0).style, Style{.bold = true}); // title
    EXPECT_EQ(grid.at(1, 1).style, Style{.dim = true});  // rule
    EXPECT_EQ(grid.at(0, 1).style, Style{});
    EXPECT_EQ(grid.at(38, 10).style, Style{.dim = true});
    EXPECT_EQ(grid.at(39, 10).style, Style{});
    EXPECT_EQ(grid.at(0, 2).style, Style{.accent = true}); // the cursor's row
    EXPECT_EQ(grid.at(1, 2).style, (Style{.bold = true, .accent = true}));
    EXPECT_EQ(grid.at(39, 2).style, Style{.accent = true});
    EXPECT_EQ(grid.at(0, 3).style, Style{}); // another row, a list
    EXPECT_EQ(grid.at(1, 3).style, Style{.bold = true});
    EXPECT_EQ(grid.at(37, 3).style, Style{.dim = true});
    EXPECT_EQ(grid.at(39, 3).style, Style{});
    EXPECT_EQ(grid.at(1, 6).style, Style{.bold = true}); // a leaf: name, value
    EXPECT_EQ(grid.at(37, 6).style, Style{});
    EXPECT_EQ(grid.at(1, 11).style, Style{}); // status, hint
    EXPECT_EQ(grid.at(38, 11).style, Style{.dim = true});
    EXPECT_EQ(grid.cursor(), std::nullopt);
}

TEST_F(PaneViewTest, TheCursorsRowHasItsValueInTheAccentColourToo) {
    stage.tick(display());
    stage.press(Key::End);
    stage.frontEnd.resize(40, 12);
    EXPECT_EQ(styleAt(1, 6), (Style{.bold = true, .accent = true}));
    EXPECT_EQ(styleAt(37, 6), Style{.accent = true});
}

TEST_F(PaneViewTest, AChangedValueIsMarkedForOneTick) {
    stage.tick(display("-94.75 dBm"));
    stage.press(Key::Enter);
    stage.frontEnd.resize(40, 12);
    EXPECT_EQ(stage.line(5), " Measured RSRP              -94.75 dBm");
    stage.tick(display("-96.00 dBm"));
    EXPECT_EQ(stage.line(5), " Measured RSRP              -96.00 dBm *");
    EXPECT_EQ(styleAt(39, 5), Style{.bold = true});
    EXPECT_EQ(styleAt(37, 5), Style{.bold = true});
    EXPECT_EQ(styleAt(37, 6), Style{}); // its neighbour did not change
    stage.tick(display("-96.00 dBm"));
    EXPECT_EQ(stage.line(5), " Measured RSRP              -96.00 dBm");
    EXPECT_EQ(styleAt(37, 5), Style{});
}

} // namespace
} // namespace pallax::terminal
