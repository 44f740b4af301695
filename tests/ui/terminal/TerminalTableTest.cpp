#include "ui/terminal/TerminalTable.h"

#include "tests/doubles/Property.h"
#include "tests/ui/terminal/TextRows.h"
#include "ui/terminal/TerminalToolkit.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <algorithm>
#include <initializer_list>
#include <string>
#include <vector>

namespace pallax::terminal {
namespace {

class TerminalTableTest : public testing::Test {
protected:
    TerminalTableTest() { show(3); }

    /// As a drawing does.
    void show(std::size_t rows, int columns = 80) {
        source.bounds = rowContentBounds(columns);
        table.setViewport(rows, source.bounds);
    }
    void reload(std::initializer_list<const char*> names) {
        source.set(names);
        table.reloadData();
    }
    /// The rows in the window, that of the cursor between brackets.
    std::string window(std::size_t rows = 3) {
        std::string text;
        for (std::size_t shown = table.firstShown();
             shown < std::min(table.firstShown() + rows, table.shownRows()); ++shown) {
            const std::string name = source.rows.at(table.rowAt(shown)).name;
            text += shown == table.cursor() ? "[" + name + "]" : name;
            text += " ";
        }
        return text;
    }

    TextRows source{"A", "B", "C", "D", "E"};
    int displays = 0;
    TerminalTable table{source, {}, [this] { ++displays; }};
};

TEST_F(TerminalTableTest, StandsOnTheFirstRowAtFirst) {
    EXPECT_EQ(window(), "[A] B C ");
    EXPECT_EQ(table.totalRows(), 5U);
    EXPECT_EQ(table.cursorRow(), 0U);
}

TEST_F(TerminalTableTest, TheWindowFollowsTheCursorAndBothStopAtTheEnds) {
    table.moveCursor(2);
    EXPECT_EQ(window(), "A B [C] ");
    table.moveCursor(1);
    EXPECT_EQ(window(), "B C [D] ");
    table.moveCursor(7);
    EXPECT_EQ(window(), "C D [E] ");
    table.moveCursor(-2);
    EXPECT_EQ(window(), "[C] D E ");
    table.moveCursor(-1);
    EXPECT_EQ(window(), "[B] C D ");
    table.moveCursor(-7);
    EXPECT_EQ(window(), "[A] B C ");
}

TEST_F(TerminalTableTest, ScrollingMovesTheWindowAndTheCursorOnlyWithIt) {
    table.scroll(1);
    EXPECT_EQ(window(), "[B] C D ");
    table.moveCursor(1);
    table.scroll(-1);
    EXPECT_EQ(window(), "A B [C] ");
    table.scroll(9);
    EXPECT_EQ(window(), "[C] D E ");
    table.scroll(-9);
    EXPECT_EQ(window(), "A B [C] ");
    reload({});
    table.scroll(1);
    EXPECT_EQ(table.cursor(), 0U);
}

TEST_F(TerminalTableTest, GoesToARowAndToTheEnd) {
    table.moveToEnd();
    EXPECT_EQ(window(), "C D [E] ");
    table.moveCursorTo(1);
    EXPECT_EQ(window(), "[B] C D ");
    table.moveCursorTo(99);
    EXPECT_EQ(window(), "C D [E] ");
}

TEST_F(TerminalTableTest, APageIsTheWindowLessOneRowAndAtLeastOne) {
    EXPECT_EQ(table.page(), 2);
    show(20);
    EXPECT_EQ(table.page(), 19);
    show(1);
    EXPECT_EQ(table.page(), 1);
    show(0);
    EXPECT_EQ(table.page(), 1);
}

TEST_F(TerminalTableTest, EveryMoveAsksForDisplay) {
    table.moveCursor(1);
    table.moveCursorTo(0);
    table.setFilter("a");
    table.reloadData();
    table.deselectRow(0, false);
    EXPECT_EQ(displays, 5);
    show(2); // a drawing's own, which asks for no other
    EXPECT_EQ(displays, 5);
}

TEST_F(TerminalTableTest, TheCursorStaysOnItsRowWhenRowsCome) {
    table.moveCursorTo(2);
    reload({"0", "1", "A", "B", "C", "D", "E"});
    EXPECT_EQ(table.cursor(), 4U);
    EXPECT_EQ(window(), "A B [C] ");
}

TEST_F(TerminalTableTest, ACursorThatWasNeverMovedStaysOnItsRowToo) {
    reload({"0", "A", "B"});
    EXPECT_EQ(window(), "0 [A] B ");
}

TEST_F(TerminalTableTest, TheCursorComesBackToItsRowWhenAllRowsWereGone) {
    table.moveCursorTo(2);
    reload({});
    table.moveCursor(1);
    reload({"A", "B", "C", "D"});
    EXPECT_EQ(window(), "A B [C] ");
}

TEST_F(TerminalTableTest, TheCursorComesBackToItsRowWhenNoRowPassedTheFilter) {
    table.moveCursorTo(3);
    table.setFilter("no such row");
    table.setFilter("");
    EXPECT_EQ(window(), "B C [D] ");
}

TEST_F(TerminalTableTest, TheCursorStaysOnItsRowWhenRowsGo) {
    table.moveCursorTo(3);
    reload({"B", "D"});
    EXPECT_EQ(window(), "B [D] ");
}

TEST_F(TerminalTableTest, TheCursorStaysOnItsRowWhenRowsMove) {
    table.moveCursorTo(1);
    reload({"E", "D", "C", "B", "A"});
    EXPECT_EQ(table.cursor(), 3U);
    EXPECT_EQ(window(), "D C [B] ");
}

TEST_F(TerminalTableTest, OfSeveralRowsOfItsNameTheNearestIsTaken) {
    reload({"X", "-", "-", "-", "X"});
    table.moveCursorTo(4);
    reload({"X", "-", "-", "X", "-", "-", "X"});
    EXPECT_EQ(table.cursor(), 3U);
    reload({"X", "-", "-", "-", "-", "X"});
    EXPECT_EQ(table.cursor(), 5U);
}

TEST_F(TerminalTableTest, WhereItsRowIsGoneTheCursorStaysAtItsPlace) {
    table.moveCursorTo(2);
    reload({"A", "B", "D", "E"});
    EXPECT_EQ(window(), "A B [D] ");
    reload({"0", "A", "B", "D", "E"});
    EXPECT_EQ(window(), "A B [D] ");
}

TEST_F(TerminalTableTest, WhereItsRowAndItsPlaceAreGoneTheCursorStandsOnTheLast) {
    table.moveToEnd();
    reload({"A", "B"});
    EXPECT_EQ(window(), "A [B] ");
}

TEST_F(TerminalTableTest, WithoutRowsThereIsNoCursor) {
    reload({});
    EXPECT_EQ(table.cursor(), 0U);
    EXPECT_EQ(table.cursorRow(), std::nullopt);
    table.moveCursor(1);
    table.moveCursor(-1);
    table.moveToEnd();
    EXPECT_EQ(table.cursor(), 0U);
    EXPECT_FALSE(table.scrollSideways(8));
}

TEST_F(TerminalTableTest, AFilterKeepsRowsByNameOrValueWhateverTheCase) {
    source.rows = {leafRow("Measured RSRP", "-94.75 dBm"), leafRow("Version", "1"),
                   leafRow("Kind", "Average rsrp"), branchRow("Cells")};
    table.reloadData();
    table.setFilter("RsRp");
    EXPECT_EQ(table.shownRows(), 2U);
    EXPECT_EQ(table.totalRows(), 4U);
    EXPECT_EQ(window(), "[Measured RSRP] Kind ");
    table.setFilter("cell");
    EXPECT_EQ(window(), "[Cells] ");
    EXPECT_EQ(table.cursorRow(), 3U);
    table.setFilter("");
    EXPECT_EQ(table.shownRows(), 4U);
}

TEST_F(TerminalTableTest, TheCursorStaysOnItsRowUnderAFilterAndBehindIt) {
    reload({"xA", "B", "xC", "D", "xE"});
    table.moveCursorTo(4);
    table.setFilter("x");
    EXPECT_EQ(window(), "xA xC [xE] ");
    table.moveCursor(-1);
    table.setFilter("");
    EXPECT_EQ(table.cursorRow(), 2U);
}

TEST_F(TerminalTableTest, AFilterHoldsForNewData) {
    reload({"xA", "B", "xC"});
    table.setFilter("x");
    table.moveCursor(1);
    reload({"B", "x0", "xA", "B2", "xC", "x9"});
    EXPECT_EQ(table.shownRows(), 4U);
    EXPECT_EQ(table.cursorRow(), 4U);
}

TEST_F(TerminalTableTest, AFilterThatNothingPassesShowsNoRow) {
    table.setFilter("nothing like it");
    EXPECT_EQ(table.shownRows(), 0U);
    EXPECT_EQ(table.cursorRow(), std::nullopt);
    table.setFilter("");
    EXPECT_EQ(table.cursorRow(), 0U);
}

TEST_F(TerminalTableTest, ARowThatFitsDoesNotScrollSideways) {
    EXPECT_FALSE(table.scrollSideways(8));
    EXPECT_FALSE(table.scrollSideways(-8));
    EXPECT_EQ(table.sidewaysOffset(), 0);
}

TEST_F(TerminalTableTest, ABranchDoesNotScrollSideways) {
    source.rows = {branchRow(std::string(200, 'n'))};
    table.reloadData();
    EXPECT_FALSE(table.scrollSideways(8));
}

TEST_F(TerminalTableTest, ALongRowScrollsAsFarAsItsContainer) {
    show(3, 20);
    source.rows = {leafRow("Name of 14 col", "123456"), leafRow("Next", "-")};
    table.reloadData();
    EXPECT_TRUE(table.scrollSideways(8));
    EXPECT_TRUE(table.scrollSideways(8));
    EXPECT_EQ(table.sidewaysOffset(), 16);
    EXPECT_TRUE(table.scrollSideways(8)); // the content is both texts wider than the row
    EXPECT_EQ(table.sidewaysOffset(), 20);
    EXPECT_FALSE(table.scrollSideways(8));
    EXPECT_TRUE(table.scrollSideways(-8));
    EXPECT_EQ(table.sidewaysOffset(), 12);
    EXPECT_TRUE(table.scrollSideways(-20));
    EXPECT_FALSE(table.scrollSideways(-8));
}

TEST_F(TerminalTableTest, AnotherRowOrAnotherWidthIsNotScrolled) {
    show(3, 20);
    source.rows = {leafRow("Name of 14 col", "123456"), leafRow("Next", "-")};
    table.reloadData();
    table.scrollSideways(8);
    table.reloadData();
    EXPECT_EQ(table.sidewaysOffset(), 8); // new data leaves it
    table.moveCursor(1);
    EXPECT_EQ(table.sidewaysOffset(), 0);
    table.moveCursor(-1);
    table.scrollSideways(8);
    show(3, 21);
    EXPECT_EQ(table.sidewaysOffset(), 0);
}

TEST_F(TerminalTableTest, AScrolledRowThatNewDataShortensScrollsFromWhereItIsSeen) {
    show(3, 22);
    source.rows = {leafRow("Name of 14 col", "123456")};
    table.reloadData();
    table.scrollSideways(20);
    source.rows = {leafRow("Name of 14 col", "12")}; // scrolls by 16 columns, no more
    table.reloadData();
    EXPECT_FALSE(table.scrollSideways(8));
    EXPECT_TRUE(table.scrollSideways(-8));
    EXPECT_EQ(table.sidewaysOffset(), 8);
    source.rows = {leafRow("Name of 14 col", "")}; // fits
    table.reloadData();
    EXPECT_FALSE(table.scrollSideways(-8));
}

TEST_F(TerminalTableTest, AWindowThatGrowsLeavesNoRoomBelowTheLastRow) {
    table.moveToEnd();
    show(4);
    EXPECT_EQ(window(4), "B C D [E] ");
    show(9);
    EXPECT_EQ(window(9), "A B C D [E] ");
    show(1);
    EXPECT_EQ(window(1), "[E] ");
}

TEST_F(TerminalTableTest, ATableSizedToFitShowsAllItsRows) {
    table.moveToEnd();
    table.sizeToFit();
    EXPECT_EQ(window(5), "A B C D [E] ");
    EXPECT_EQ(table.contentBounds(), rowContentBounds(80));
}

TEST_F(TerminalTableTest, HasNoCellToSpare) {
    EXPECT_EQ(table.dequeueReusableCell("Row"), nullptr);
}

TEST(FindIgnoringCaseTest, FindsAsciiInAnyCaseAndOtherBytesAsTheyAre) {
    EXPECT_EQ(findIgnoringCase("Measured RSRP", "rsrp"), 9U);
    EXPECT_EQ(findIgnoringCase("abc", "ABC"), 0U);
    EXPECT_EQ(findIgnoringCase("größe", "ÖSS"), std::string_view::npos);
    EXPECT_EQ(findIgnoringCase("漢字", "字"), 3U);
    EXPECT_EQ(findIgnoringCase("[x", "{X"), std::string_view::npos); // a bit apart, no letters
    EXPECT_EQ(findIgnoringCase("ab", "abc"), std::string_view::npos);
    EXPECT_EQ(findIgnoringCase("", ""), 0U);
    EXPECT_EQ(findIgnoringCase("abc", ""), 0U);
}

TEST_F(TerminalTableTest, WhateverHappensTheCursorIsOnARowInTheWindow) {
    EXPECT_TRUE(doubles::holds([this] {
        const auto names = rc::gen::container<std::vector<std::string>>(
            rc::gen::element<std::string>("A", "B", "C", "xA", "xB", "xC"));
        const int steps = *rc::gen::inRange(1, 30);
        for (int step = 0; step < steps; ++step) {
            switch (*rc::gen::inRange(0, 6)) {
            case 0:
                source.rows.clear();
                for (const std::string& name : *names) {
                    source.rows.push_back(leafRow(name, std::string(40, 'v')));
                }
                table.reloadData();
                break;
            case 1:
                table.moveCursor(*rc::gen::inRange(-9, 9));
                break;
            case 2:
                table.setFilter(*rc::gen::element<std::string>("", "x", "a", "q"));
                break;
            case 3:
                show(*rc::gen::inRange<std::size_t>(0, 8), *rc::gen::inRange(0, 100));
                break;
            case 4:
                (void)table.scrollSideways(*rc::gen::inRange(-20, 20));
                break;
            default:
                table.moveToEnd();
                break;
            }
            const std::size_t count = table.shownRows();
            RC_ASSERT(count <= table.totalRows());
            RC_ASSERT((table.cursor() < count || (count == 0 && table.cursor() == 0U)));
            RC_ASSERT(table.firstShown() <= table.cursor());
            RC_ASSERT(table.sidewaysOffset() >= 0);
            RC_ASSERT((count == 0 || table.cursorRow().value() < table.totalRows()));
        }
    }));
}

} // namespace
} // namespace pallax::terminal
