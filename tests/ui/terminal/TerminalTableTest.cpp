#include "ui/terminal/TerminalTable.h"

#include "tests/doubles/Property.h"
#include "tests/ui/terminal/TextRows.h"
#include "ui/terminal/TerminalToolkit.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <initializer_list>
#include <string>
#include <vector>

namespace pallax::terminal {
namespace {

namespace any = doubles::any;

class TerminalTableTest : public testing::Test {
protected:
    TerminalTableTest() { show(3); }

    /// Like a drawing.
    void show(std::size_t rows, int columns = 80) {
        source.bounds = rowContentBounds(columns);
        table.setViewport(rows, source.bounds);
    }
    void reload(std::initializer_list<const char*> names) {
        source.pane().show(doubles::sectionOf(names));
        table.reloadData();
    }
    /// The rows in the window, with the cursor's in brackets.
    std::string window(std::size_t rows = 3) {
        std::string text;
        for (std::size_t shown = table.firstShown();
             shown < std::min(table.firstShown() + rows, table.pane().shownRows()); ++shown) {
            const std::string name = source.pane().row(table.pane().rowAt(shown)).name;
            text += shown == table.pane().cursor() ? "[" + name + "]" : name;
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
    EXPECT_EQ(table.pane().totalRows(), 5U);
    EXPECT_EQ(table.pane().cursorRow(), 0U);
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
    EXPECT_EQ(table.pane().cursor(), 0U);
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
    show(2); // a drawing does not request another
    EXPECT_EQ(displays, 5);
}

TEST_F(TerminalTableTest, TheCursorStaysOnItsRowWhenRowsCome) {
    table.moveCursorTo(2);
    reload({"0", "1", "A", "B", "C", "D", "E"});
    EXPECT_EQ(table.pane().cursor(), 4U);
    EXPECT_EQ(window(), "A B [C] ");
}

TEST_F(TerminalTableTest, TheCursorStaysOnItsRowWhenRowsGo) {
    table.moveCursorTo(3);
    reload({"B", "D"});
    EXPECT_EQ(window(), "B [D] ");
}

TEST_F(TerminalTableTest, TheCursorStaysOnItsRowWhenRowsMove) {
    table.moveCursorTo(1);
    reload({"E", "D", "C", "B", "A"});
    EXPECT_EQ(table.pane().cursor(), 3U);
    EXPECT_EQ(window(), "D C [B] ");
}

TEST_F(TerminalTableTest, WhereItsRowIsGoneTheCursorStaysAtItsPlace) {
    table.moveCursorTo(2);
    reload({"A", "B", "D", "E"});
    EXPECT_EQ(window(), "A B [D] ");
    reload({"0", "A", "B", "D", "E"});
    EXPECT_EQ(window(), "A B [D] ");
}

TEST_F(TerminalTableTest, WithoutRowsThereIsNoCursor) {
    reload({});
    EXPECT_EQ(table.pane().cursor(), 0U);
    EXPECT_EQ(table.pane().cursorRow(), std::nullopt);
    table.moveCursor(1);
    table.moveCursor(-1);
    table.moveToEnd();
    EXPECT_EQ(table.pane().cursor(), 0U);
    EXPECT_FALSE(table.scrollSideways(8));
}

TEST_F(TerminalTableTest, TheWindowFollowsTheCursorUnderAFilterAndAfterIt) {
    reload({"xA", "B", "xC", "D", "xE"});
    table.moveCursorTo(4);
    table.setFilter("x");
    EXPECT_EQ(window(), "xA xC [xE] ");
    table.moveCursor(-2);
    table.setFilter("");
    EXPECT_EQ(window(), "[xA] B xC ");
}

TEST_F(TerminalTableTest, ARowThatFitsDoesNotScrollSideways) {
    EXPECT_FALSE(table.scrollSideways(8));
    EXPECT_FALSE(table.scrollSideways(-8));
    EXPECT_EQ(table.sidewaysOffset(), 0);
}

TEST_F(TerminalTableTest, ABranchDoesNotScrollSideways) {
    source.show({doubles::treeNode(std::string(200, 'n'), {})});
    table.reloadData();
    EXPECT_FALSE(table.scrollSideways(8));
}

TEST_F(TerminalTableTest, ALongRowScrollsAsFarAsItsContainer) {
    show(3, 20);
    source.show({doubles::leafNode("Name of 14 col", "123456"), doubles::leafNode("Next", "-")});
    table.reloadData();
    EXPECT_TRUE(table.scrollSideways(8));
    EXPECT_TRUE(table.scrollSideways(8));
    EXPECT_EQ(table.sidewaysOffset(), 16);
    EXPECT_TRUE(table.scrollSideways(8)); // the content exceeds the row by the width of both texts
    EXPECT_EQ(table.sidewaysOffset(), 20);
    EXPECT_FALSE(table.scrollSideways(8));
    EXPECT_TRUE(table.scrollSideways(-8));
    EXPECT_EQ(table.sidewaysOffset(), 12);
    EXPECT_TRUE(table.scrollSideways(-20));
    EXPECT_FALSE(table.scrollSideways(-8));
}

TEST_F(TerminalTableTest, AnotherRowOrAnotherWidthIsNotScrolled) {
    show(3, 20);
    source.show({doubles::leafNode("Name of 14 col", "123456"), doubles::leafNode("Next", "-")});
    table.reloadData();
    table.scrollSideways(8);
    table.reloadData();
    EXPECT_EQ(table.sidewaysOffset(), 8); // new data keeps the offset
    table.moveCursor(1);
    EXPECT_EQ(table.sidewaysOffset(), 0);
    table.moveCursor(-1);
    table.scrollSideways(8);
    show(3, 21);
    EXPECT_EQ(table.sidewaysOffset(), 0);
}

TEST_F(TerminalTableTest, ARowInThePlaceOfAScrolledOneIsNotScrolled) {
    show(3, 20);
    source.show({doubles::leafNode("Name of 14 col", "123456")});
    table.reloadData();
    table.scrollSideways(8);
    source.show({doubles::leafNode("Name of 14 con", "123456")});
    table.reloadData();
    EXPECT_EQ(table.sidewaysOffset(), 0);
}

TEST_F(TerminalTableTest, AScrolledRowThatNewDataShortensScrollsFromWhereItIsSeen) {
    show(3, 22);
    source.show({doubles::leafNode("Name of 14 col", "123456")});
    table.reloadData();
    table.scrollSideways(20);
    source.show({doubles::leafNode("Name of 14 col", "12")}); // scrolls by 16 columns at most
    table.reloadData();
    EXPECT_FALSE(table.scrollSideways(8));
    EXPECT_TRUE(table.scrollSideways(-8));
    EXPECT_EQ(table.sidewaysOffset(), 8);
    source.show({doubles::leafNode("Name of 14 col", "")}); // fits
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

TEST_F(TerminalTableTest, WhateverHappensTheCursorIsOnARowInTheWindow) {
    EXPECT_TRUE(doubles::holds([this] {
        constexpr auto kNames = std::to_array<const char*>({"A", "B", "C", "xA", "xB", "xC"});
        constexpr auto kFilters = std::to_array<const char*>({"", "x", "a", "q"});
        const int steps = any::between(1, 30);
        for (int step = 0; step < steps; ++step) {
            switch (any::between(0, 6)) {
            case 0: {
                std::vector<NodeRef> rows;
                for (const int name : any::integers(0, static_cast<int>(kNames.size()))) {
                    rows.push_back(doubles::leafNode(kNames.at(static_cast<std::size_t>(name)),
                                                     std::string(40, 'v')));
                }
                source.show(std::move(rows));
                table.reloadData();
                break;
            }
            case 1:
                table.moveCursor(any::between(-9, 9));
                break;
            case 2:
                table.setFilter(any::elementOf(kFilters));
                break;
            case 3:
                show(any::index(8), any::between(0, 100));
                break;
            case 4:
                (void)table.scrollSideways(any::between(-20, 20));
                break;
            default:
                table.moveToEnd();
                break;
            }
            const std::size_t count = table.pane().shownRows();
            RC_ASSERT(count <= table.pane().totalRows());
            RC_ASSERT(
                (table.pane().cursor() < count || (count == 0 && table.pane().cursor() == 0U)));
            RC_ASSERT(table.firstShown() <= table.pane().cursor());
            RC_ASSERT(table.sidewaysOffset() >= 0);
            RC_ASSERT((count == 0 || table.pane().cursorRow().value() < table.pane().totalRows()));
        }
    }));
}

} // namespace
} // namespace pallax::terminal
