#include "ui/terminal/ModalView.h"

#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

class ModalViewTest : public StageFixture {
protected:
    ModalViewTest() {
        stage.tick(display());
        stage.press(Key::Enter);
        stage.saveHistory = snapshotItems();
    }
};

TEST_F(ModalViewTest, TheSaveScreenLiesOverThePane) {
    stage.type("stunnel entrance");
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────────────────────────────────────────────────────
▌Version                                                                     1
 E-ARFCN                                                                  1850
 Physical Cell ID                                                          274
 Measured RSRP                                                      -94.75 dBm
 Average RSRP                                                       -95.00 dBm
 M┌ Save snapshot ───────────────────────────────────────────────────────────┐
  │ ✓ Snapshot (2023-11-14 22:13:14 +0000)                                   │
  │ ✓ Snapshot (2023-11-14 22:13:16 +0000)                                   │
  │ ✓ DLF binary (48213 bytes)                                               │
  │                                                                          │
  │ Description  tunnel entrance                                             │
  │                                                                          │
  │                                                      [ Save ] [ Cancel ] │
  └──────────────────────────────────────────────────────────────────────────┘






 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    EXPECT_EQ(stage.screen(40, 12), R"(
 Pallax › Serving Cell Measurements
┌ Save snapshot ───────────────────────┐
│ ✓ Snapshot (2023-11-14 22:13:14 +000 │
│ ✓ Snapshot (2023-11-14 22:13:16 +000 │
│ ✓ DLF binary (48213 bytes)           │
│                                      │
│ Description  tunnel entrance         │
│                                      │
│                  [ Save ] [ Cancel ] │
└──────────────────────────────────────┘
 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
    EXPECT_EQ(stage.screen(20, 5), R"(
┌ Save snapshot ───┐
│ ✓ Snapshot (2023 │
│ tunnel entrance  │
│  [Save] [Cancel] │
└──────────────────┘
)");
}

TEST_F(ModalViewTest, WhereRoomIsScarceTheFieldsNameStandsInItUntilSomethingIsTyped) {
    stage.type("s");
    EXPECT_EQ(stage.screen(20, 5), R"(
┌ Save snapshot ───┐
│ ✓ Snapshot (2023 │
│ Description      │
│  [Save] [Cancel] │
└──────────────────┘
)");
    EXPECT_EQ(styleAt(2, 2), Style{.dim = true});
    EXPECT_EQ(draw().cursor(), (Position{2, 2}));
}

TEST_F(ModalViewTest, TheSaveScreenIsNotDrawnWhereItHasNoRoom) {
    stage.type("s");
    EXPECT_EQ(stage.screen(19, 5), "\nPallax needs 20x5\n\n\n\n\n");
    EXPECT_EQ(stage.screen(1, 1), "\n2\n");
    EXPECT_EQ(stage.screen(0, 0), "\n");
}

TEST_F(ModalViewTest, WithoutContentsThereIsOnlyTheFieldAndTheButtons) {
    stage.saveHistory = {};
    stage.type("s");
    EXPECT_EQ(stage.screen(40, 12), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────────────
▌Version                             1
┌ Save snapshot ───────────────────────┐
│                                      │
│ Description                          │
│                                      │
│                  [ Save ] [ Cancel ] │
└──────────────────────────────────────┘

 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

TEST_F(ModalViewTest, WhatIsWhereTellsItsStyle) {
    stage.type("sab");
    stage.frontEnd.resize(40, 12);
    const Grid grid = draw();
    EXPECT_EQ(grid.at(2, 1).style, Style{.bold = true});       // title
    EXPECT_EQ(grid.at(2, 2).style, Style{.bold = true});       // check mark
    EXPECT_EQ(grid.at(4, 2).style, Style{});                   // item
    EXPECT_EQ(grid.at(2, 6).style, Style{.bold = true});       // field's name
    EXPECT_EQ(grid.at(15, 6).style, Style{.underline = true}); // text being edited
    EXPECT_EQ(grid.at(20, 8).style, Style{});                  // buttons
    EXPECT_EQ(grid.at(30, 8).style, Style{});
    EXPECT_EQ(grid.cursor(), (Position{17, 6}));
}

TEST_F(ModalViewTest, TheButtonWithTheKeysStandsOutWithoutColoursToo) {
    constexpr Style kFocus{.bold = true, .underline = true, .accent = true};
    stage.type("sab");
    stage.frontEnd.resize(40, 12);
    stage.press(Key::Enter);
    EXPECT_EQ(styleAt(19, 8), kFocus);
    EXPECT_EQ(styleAt(28, 8), Style{});
    EXPECT_EQ(styleAt(15, 6), Style{}); // the text is no longer edited
    EXPECT_EQ(draw().cursor(), std::nullopt);
    stage.press(Key::Tab);
    EXPECT_EQ(styleAt(19, 8), Style{});
    EXPECT_EQ(styleAt(28, 8), kFocus);
}

TEST_F(ModalViewTest, ADescriptionLongerThanItsRoomScrollsWithItsCursor) {
    stage.type("s0123456789abcdefghi");
    stage.frontEnd.resize(20, 5);
    EXPECT_EQ(stage.line(2), "│ 456789abcdefghi  │");
    EXPECT_EQ(draw().cursor(), (Position{17, 2}));
    stage.press(Key::Home);
    EXPECT_EQ(stage.line(2), "│ 0123456789abcdef │");
    EXPECT_EQ(draw().cursor(), (Position{2, 2}));
}

TEST_F(ModalViewTest, WideCharactersInTheDescriptionKeepTheFrameStraight) {
    stage.type("s漢字e\u0301漢字漢字漢字漢字");
    stage.frontEnd.resize(20, 5);
    EXPECT_EQ(stage.line(2), "│  字漢字漢字漢字  │");
    EXPECT_EQ(faultOf(draw()), "");
    stage.press(Key::Home);
    EXPECT_EQ(stage.line(2), "│ 漢字e\u0301漢字漢字漢  │");
    EXPECT_EQ(faultOf(draw()), "");
}

TEST_F(ModalViewTest, AnItemsControlCharactersAreEscaped) {
    stage.saveHistory = Array{Dictionary{{"Description", "Esc\x1b[2J"}}};
    stage.type("s");
    stage.frontEnd.resize(40, 12);
    EXPECT_EQ(stage.line(3), "│ ✓ Esc\\x1B[2J                         │");
}

} // namespace
} // namespace pallax::terminal
