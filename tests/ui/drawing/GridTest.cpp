#include "ui/drawing/Grid.h"

#include "tests/doubles/Property.h"
#include "tests/ui/drawing/GridSupport.h"

#include <gtest/gtest.h>

#include <array>
#include <string>
#include <utility>
#include <vector>

namespace pallax::terminal {
namespace {

namespace any = doubles::any;

TEST(GridTest, IsBlankAtFirst) {
    const Grid grid(3, 2);
    EXPECT_EQ(grid.columns(), 3);
    EXPECT_EQ(grid.rows(), 2);
    EXPECT_EQ(grid.at(2, 1), (Grid::Cell{" ", {}}));
    EXPECT_EQ(grid.text(), "\n\n");
    EXPECT_EQ(grid.cursor(), std::nullopt);
}

TEST(GridTest, ANegativeExtentCountsAsNone) {
    const Grid grid(-1, -5);
    EXPECT_EQ(grid.columns(), 0);
    EXPECT_EQ(grid.rows(), 0);
    EXPECT_EQ(grid.text(), "");
}

TEST(GridTest, ATextIsPutWithItsStyleAndTheColumnBehindItReturned) {
    Grid grid(8, 2);
    EXPECT_EQ(grid.put(1, 1, "abc", {.bold = true}), 4);
    EXPECT_EQ(grid.text(), "\n abc\n");
    EXPECT_EQ(grid.at(0, 1).style, Style{});
    EXPECT_EQ(grid.at(1, 1).style, Style{.bold = true});
    EXPECT_EQ(grid.at(3, 1).style, Style{.bold = true});
    EXPECT_EQ(grid.at(4, 1).style, Style{});
}

TEST(GridTest, WhatLiesOutsideIsCutOff) {
    Grid grid(4, 1);
    EXPECT_EQ(grid.put(-2, 0, "abcdefgh"), 6);
    EXPECT_EQ(grid.text(), "cdef\n");
    EXPECT_EQ(grid.put(9, 0, "x"), 10);
    EXPECT_EQ(grid.put(0, 1, "below"), 5);
    EXPECT_EQ(grid.put(0, -1, "above"), 5);
    EXPECT_EQ(grid.text(), "cdef\n");
}

TEST(GridTest, ATextIsCutAtItsClip) {
    Grid grid(8, 1);
    EXPECT_EQ(grid.put(1, 0, "abcdef", {}, {2, 5}), 7);
    EXPECT_EQ(grid.text(), "  bcd\n");
}

TEST(GridTest, AClipMayBeEmptyOrReachBeyondTheGrid) {
    Grid grid(4, 1);
    grid.put(0, 0, "abcd", {}, {3, 1});
    EXPECT_EQ(grid.text(), "\n");
    grid.put(0, 0, "abcdef", {}, {-5, 50});
    EXPECT_EQ(grid.text(), "abcd\n");
}

TEST(GridTest, AGridWithoutAColumnTakesAnyText) {
    for (const auto& [columns, rows] : {std::pair{0, 0}, {0, 3}, {3, 0}}) {
        Grid grid(columns, rows);
        EXPECT_EQ(grid.put(0, 0, "ab漢"), 4);
        grid.fill({-3, 3}, 0, "-");
        grid.clear(-1, -1, 9, 9);
        EXPECT_EQ(grid.text(), std::string(static_cast<std::size_t>(rows), '\n'));
    }
}

TEST(GridTest, AWideCharacterTakesTwoCells) {
    Grid grid(6, 1);
    EXPECT_EQ(grid.put(1, 0, "漢x", {.underline = true}), 4);
    EXPECT_EQ(grid.at(1, 0), (Grid::Cell{"漢", {.underline = true}}));
    EXPECT_EQ(grid.at(2, 0), (Grid::Cell{"", {.underline = true}}));
    EXPECT_EQ(grid.at(3, 0).text, "x");
    EXPECT_EQ(grid.text(), " 漢x\n");
}

TEST(GridTest, HalfOfAWideCharacterAtEitherEdgeIsABlank) {
    Grid grid(4, 1);
    EXPECT_EQ(grid.put(-1, 0, "漢字漢"), 5);
    EXPECT_EQ(grid.at(0, 0).text, " ");
    EXPECT_EQ(grid.at(1, 0).text, "字");
    EXPECT_EQ(grid.at(2, 0).text, "");
    EXPECT_EQ(grid.at(3, 0).text, " ");
    EXPECT_EQ(grid.text(), " 字\n");
}

TEST(GridTest, HalfOfAWideCharacterAtTheClipIsABlankInTheTextsStyle) {
    Grid grid(6, 1);
    grid.put(0, 0, "abcdef");
    grid.put(0, 0, "漢字漢", {.bold = true}, {1, 5});
    EXPECT_EQ(grid.text(), "a 字 f\n");
    EXPECT_EQ(grid.at(1, 0).style, Style{.bold = true});
    EXPECT_EQ(grid.at(4, 0).style, Style{.bold = true});
    EXPECT_EQ(grid.at(5, 0).style, Style{});
}

TEST(GridTest, OverwritingOneHalfOfAWideCharacterBlanksTheOther) {
    Grid left(4, 1);
    left.put(1, 0, "漢");
    left.put(1, 0, "x");
    EXPECT_EQ(left.at(1, 0).text, "x");
    EXPECT_EQ(left.at(2, 0).text, " ");
    Grid right(4, 1);
    right.put(1, 0, "漢");
    right.put(2, 0, "x");
    EXPECT_EQ(right.at(1, 0).text, " ");
    EXPECT_EQ(right.at(2, 0).text, "x");
}

TEST(GridTest, TheRightHalfOfAWideCharacterOverwritesTheLeftHalfOfAnother) {
    Grid grid(4, 1);
    grid.put(1, 0, "漢");
    grid.put(0, 0, "字");
    EXPECT_EQ(grid.at(0, 0).text, "字");
    EXPECT_EQ(grid.at(1, 0).text, "");
    EXPECT_EQ(grid.at(2, 0).text, " ");
}

TEST(GridTest, ACombiningCharacterSharesTheCellOfTheOneBeforeIt) {
    Grid grid(4, 1);
    EXPECT_EQ(grid.put(0, 0, "e\u0301x"), 2);
    EXPECT_EQ(grid.at(0, 0).text, "e\u0301");
    EXPECT_EQ(grid.at(1, 0).text, "x");
}

TEST(GridTest, ClearBlanksARectangleAndTheHalvesThatItLeaves) {
    Grid grid(6, 3);
    for (int y = 0; y < 3; ++y) {
        grid.put(0, y, "漢漢漢", {.accent = true});
    }
    grid.clear(1, 1, 2, 7);
    EXPECT_EQ(grid.text(), "漢漢漢\n"
                           "    漢\n"
                           "    漢\n");
    EXPECT_EQ(grid.at(1, 1).style, Style{});
    EXPECT_EQ(faultOf(grid), "");
}

TEST(GridTest, FillRepeatsATextOverASpan) {
    Grid grid(6, 2);
    grid.fill({1, 4}, 1, "─", {.dim = true});
    EXPECT_EQ(grid.text(), "\n ───\n");
    EXPECT_EQ(grid.at(1, 1).style, Style{.dim = true});
    grid.fill({-2, 20}, 0, "=");
    EXPECT_EQ(grid.text(), "======\n ───\n");
}

TEST(GridTest, ControlCharactersAreEscapedAndBrokenBytesReplaced) {
    Grid grid(24, 1);
    EXPECT_EQ(grid.put(0, 0, "a\x1b[\n\xff\x7f\u009bz"), 22);
    EXPECT_EQ(grid.text(), "a\\x1B[\\x0A\uFFFD\\x7F\\u009Bz\n");
}

TEST(GridTest, TheCursorIsWhereItWasSet) {
    Grid grid(3, 3);
    grid.setCursor({2, 1});
    EXPECT_EQ(grid.cursor(), (Position{2, 1}));
}

/// Texts of narrow, wide, combining, control and broken characters.
std::string anyText() {
    constexpr auto kPieces =
        std::to_array<const char*>({"a", " ", "漢", "語", "😀", "한", "\u1161", "\u0301", "\u200d",
                                    "\x1b", "\xff", "\xe6\xbc", "\u0085"});
    std::string text;
    for (const int piece : any::integers(0, static_cast<int>(kPieces.size()))) {
        text += kPieces.at(static_cast<std::size_t>(piece));
    }
    return text;
}

TEST(GridTest, EveryRowFillsItsColumnsAfterAnyPut) {
    EXPECT_TRUE(doubles::holds([] {
        Grid grid(any::between(0, 12), any::between(0, 3));
        const int puts = any::between(1, 40);
        for (int count = 0; count < puts; ++count) {
            const int x = any::between(-4, 14);
            const int y = any::between(-1, 3);
            const std::string text = anyText();
            const Span clip{any::between(-3, 8), any::between(0, 14)};
            RC_ASSERT(grid.put(x, y, text, {}, clip) == x + columnsOf(text));
            if (any::between(0, 4) == 0) {
                grid.clear(any::between(-3, 12), y, any::between(0, 6), 1);
            }
            RC_ASSERT(faultOf(grid) == "");
        }
    }));
}

} // namespace
} // namespace pallax::terminal
