#include "ui/pages/Overlays.h"

#include "tests/ui/drawing/GridSupport.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <string_view>
#include <utility>

namespace pallax::terminal {
namespace {

/// A grid full of dots, to show what is drawn over it.
Grid dotted(int columns, int rows) {
    Grid grid(columns, rows);
    for (int y = 0; y < rows; ++y) {
        grid.fill({0, columns}, y, ".");
    }
    return grid;
}

std::string alertOn(int columns, int rows, const ui::Alert& alert) {
    Grid grid = dotted(columns, rows);
    drawAlert(grid, kUtf8Marks, alert);
    EXPECT_EQ(faultOf(grid), "");
    return "\n" + grid.text();
}

const ui::Alert kFileError{"File Error", "Unable to write file to disk", "Close"};

TEST(OverlaysTest, AnAlertIsABoxInTheMiddle) {
    EXPECT_EQ(alertOn(40, 6, kFileError), R"(
........................................
...┌ File Error ────────────────────┐...
...│ Unable to write file to disk   │...
...│                      [ Close ] │...
...└────────────────────────────────┘...
........................................
)");
}

TEST(OverlaysTest, AnAlertIsCutToTheScreen) {
    EXPECT_EQ(alertOn(20, 5, kFileError), R"(
┌ File Error ──────┐
│ Unable to write  │
│ file to disk     │
│        [ Close ] │
└──────────────────┘
)");
}

TEST(OverlaysTest, AnAlertIsAsWideAsItsLongestText) {
    EXPECT_EQ(alertOn(22, 4, {"A long title", "x", "OK"}), R"(
...┌ A long title ┐...
...│ x            │...
...│       [ OK ] │...
...└──────────────┘...
)");
    EXPECT_EQ(alertOn(22, 4, {"", "", "A long button"}), R"(
┌───────────────────┐.
│                   │.
│ [ A long button ] │.
└───────────────────┘.
)");
}

TEST(OverlaysTest, AnAlertShowsNoControlCharacter) {
    EXPECT_EQ(alertOn(22, 4, {"T\x1b[", "a\nb", "x\x07"}), R"(
....┌ T\x1B[ ───┐.....
....│ a\x0Ab    │.....
....│ [ x\x07 ] │.....
....└───────────┘.....
)");
}

TEST(OverlaysTest, TheAlertsTitleIsBoldAndItsButtonStandsOut) {
    Grid grid(40, 6);
    drawAlert(grid, kUtf8Marks, kFileError);
    EXPECT_EQ(grid.at(5, 1).style, Style{.bold = true});
    EXPECT_EQ(grid.at(3, 1).style, Style{});
    EXPECT_EQ(grid.at(26, 3).style, (Style{.bold = true, .underline = true, .accent = true}));
    EXPECT_EQ(grid.at(5, 2).style, Style{});
}

TEST(OverlaysTest, OverlaysAreDrawnOnGridsOfAnySize) {
    for (const auto& [columns, rows] : {std::pair{0, 0}, {1, 1}, {2, 1}, {1, 5}, {3, 2}, {4, 4}}) {
        Grid grid(columns, rows);
        drawAlert(grid, kUtf8Marks, kFileError);
        EXPECT_LE(drawHelp(grid, kUtf8Marks, 0), std::max(rows - 2, 0));
        drawTooSmall(grid);
        EXPECT_EQ(faultOf(grid), "") << columns << "x" << rows;
    }
}

TEST(OverlaysTest, TheHelpPageListsTheKeys) {
    Grid grid = dotted(51, static_cast<int>(helpLines(80).size()) + 2);
    EXPECT_EQ(drawHelp(grid, kUtf8Marks, 0), static_cast<int>(helpLines(80).size()));
    EXPECT_EQ("\n" + grid.text(), R"(
........┌ Keys ───────────────────────────┐........
........│ Up Down  k j                    │........
........│  one row up or down             │........
........│ PgUp PgDn                       │........
........│  one page up or down            │........
........│ Home End  g G                   │........
........│  first or last row              │........
........│ Enter Right l                   │........
........│  open the row                   │........
........│ Right Left  l h                 │........
........│  scroll a long row              │........
........│ Left h Backspace                │........
........│  back                           │........
........│ Esc                             │........
........│  clear the filter, or back      │........
........│ /                               │........
........│  filter rows by name or value   │........
........│ f                               │........
........│  find a text in all values      │........
........│ t                               │........
........│  a list as a table or as rows   │........
........│ < > r  x X                      │........
........│  sort a table; hide columns     │........
........│ o                               │........
........│  overview of the radio          │........
........│ e ;                             │........
........│  events; ask in SQL             │........
........│ i Enter                         │........
........│  all about the value            │........
........│ v V                             │........
........│  put it in the graph; open it   │........
........│ + -  Left Right                 │........
........│  zoom and read a curve          │........
........│ Space                           │........
........│  hold time; play on from there  │........
........│ , .                             │........
........│  one tick back or forward       │........
........│ [ ]                             │........
........│  to the event before or after   │........
........└────────────────────────── ↓ 38 ─┘........
)");
}

TEST(OverlaysTest, TheHelpPageIsShownFromALineOn) {
    Grid grid = dotted(20, 5);
    EXPECT_EQ(drawHelp(grid, kAsciiMarks, 3), 3);
    EXPECT_EQ("\n" + grid.text(), R"(
+ Keys ------------+
| PgUp PgDn        |
|  one page up or  |
|  down            |
+---------- v 106 -+
)");
}

TEST(OverlaysTest, TheHelpPageHasTheMostUsefulKeysOnTheComfortableScreen) {
    Grid grid(80, 24);
    const int shown = drawHelp(grid, kUtf8Marks, 0);
    EXPECT_EQ(shown, 22);
    for (int line = 0; line < shown; ++line) {
        const std::string text = helpLines(80)[static_cast<std::size_t>(line)];
        EXPECT_NE(grid.text().find(text), std::string::npos) << text;
    }
}

TEST(OverlaysTest, AScreenThatIsTooSmallSaysWhatItNeeds) {
    const auto on = [](int columns, int rows) {
        Grid grid(columns, rows);
        drawTooSmall(grid);
        return grid.text();
    };
    EXPECT_EQ(on(19, 5), "Pallax needs 20x5\n\n\n\n\n");
    EXPECT_EQ(on(20, 4), "Pallax needs 20x5\n\n\n\n");
    EXPECT_EQ(on(17, 1), "Pallax needs 20x5\n");
    EXPECT_EQ(on(16, 2), "Pallax needs\n20x5\n");
    EXPECT_EQ(on(16, 1), "20x5\n");
    EXPECT_EQ(on(4, 3), "Pall\n20x5\n\n");
    EXPECT_EQ(on(1, 1), "2\n");
    EXPECT_EQ(on(0, 0), "");
}

} // namespace
} // namespace pallax::terminal
