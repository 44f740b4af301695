#include "ui/drawing/ColumnTable.h"

#include "tests/ui/drawing/GridSupport.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax::terminal {
namespace {

TableCell number(double value, const std::string& text) {
    return {text, value, false};
}

TableContent neighbours() {
    return {
        {{"Physical Cell ID", "", true},
         {"Measured RSRP", "dBm"},
         {"Average RSRP", "dBm"},
         {"State"},
         {"SIR"}},
        {{"252",
          {number(252, "252"),
           number(-91.5, "-91.50"),
           number(-92, "-92.00"),
           {"camped"},
           {"6", {}, true}}},
         {"184",
          {number(184, "184"), number(-104, "-104.00"), number(-94, "-94.00"), {"漢字\x1b"}, {}}},
         {"9", {number(9, "9"), {}, number(-88, "-88.00"), {"barred"}, {"2", {}, true}}}},
        "cell",
        "cells"};
}

class ColumnTableTest : public testing::Test {
protected:
    ColumnTableTest() { table.model().show(neighbours()); }
    Grid draw(int columns, int rows, const Marks& marks = kUtf8Marks) {
        Grid grid(columns, rows);
        hits.clear();
        table.setArea(columns, rows);
        table.draw(grid, marks, hits, 0, [this](std::size_t row) { opened.push_back(row); });
        EXPECT_EQ(faultOf(grid), "");
        return grid;
    }
    std::string screen(int columns, int rows, const Marks& marks = kUtf8Marks) {
        return "\n" + draw(columns, rows, marks).text();
    }
    bool type(char32_t character) { return table.handle(typed(character)); }
    bool press(Key key) { return table.handle({.key = key}); }
    void showNumbers(int count) {
        TableContent content{{{"Number", "", true}}, {}};
        for (int row = 0; row < count; ++row) {
            const std::string text = std::to_string(row);
            content.rows.push_back({text, {number(row, text)}});
        }
        table.model().show(std::move(content));
    }

    ColumnTable table;
    HitMap hits;
    std::vector<std::size_t> opened;
};

TEST_F(ColumnTableTest, NumbersAreOnTheRightAndUnitsInTheHeading) {
    EXPECT_EQ(screen(60, 7), R"(
 Physical  Measured   Average
  Cell ID  RSRP dBm  RSRP dBm  State     SIR
▌     252    -91.50    -92.00  camped      6›
      184   -104.00    -94.00  漢字\x1B
        9              -88.00  barred      2›


)");
    EXPECT_EQ(screen(60, 4), R"(
 Physical Cell ID  Measured RSRP dBm  Average RSRP dBm     …
▌             252             -91.50            -92.00
              184            -104.00            -94.00
                9                               -88.00
)") << "a short window has one line of headings";
    EXPECT_EQ(screen(60, 1), "\n▌             252             -91.50            -92.00\n");
}

TEST_F(ColumnTableTest, OneColumnOfMarksIsBesideEachColumn) {
    TableContent later = neighbours();
    later.rows[0].cells[1] = number(-90, "-90.00");
    later.rows[2].cells[4].text = "3";
    table.model().update(later, TableModel::Changes::Mark);
    table.model().choose(1);
    const Grid grid = draw(60, 7);
    EXPECT_EQ("\n" + grid.text(), R"(
 Physical  Measured   Average
  Cell ID  RSRP dBm↑ RSRP dBm  State     SIR
      184   -104.00    -94.00  漢字\x1B
▌     252    -90.00*   -92.00  camped      6›
        9              -88.00  barred      3*


)");
    EXPECT_TRUE(grid.at(14, 3).style.bold) << "a changed value";
    EXPECT_FALSE(grid.at(24, 3).style.bold);
    EXPECT_TRUE(grid.at(11, 0).style.bold) << "the chosen column";
    EXPECT_TRUE(grid.at(1, 0).style.dim);
    EXPECT_EQ(grid.at(7, 3).style, Style{.accent = true});
    type(U'r');
    EXPECT_NE(screen(60, 7).find("RSRP dBm↓"), std::string::npos);
}

TEST_F(ColumnTableTest, AnAsciiTerminalGetsAsciiMarks) {
    table.model().choose(1);
    EXPECT_EQ(screen(40, 7, kAsciiMarks), R"(
 Physical  Measured   Average
  Cell ID  RSRP dBm^ RSRP dBm  State   ~
      184   -104.00    -94.00  )"
                                          "漢字\\x1B"
                                          R"(
>     252    -91.50    -92.00  camped
        9              -88.00  barred


)");
}

TEST_F(ColumnTableTest, ANarrowScreenScrollsSidewaysAndKeepsTheIdentity) {
    EXPECT_EQ(screen(20, 6), R"(
 Physical  Measured
  Cell ID  RSRP dBm…
)"
                             "▌     252    -91.50\n"
                             "      184   -104.00\n"
                             "        9\n\n");
    EXPECT_TRUE(press(Key::Right));
    EXPECT_TRUE(type(U'l'));
    EXPECT_TRUE(press(Key::Right));
    EXPECT_EQ(screen(20, 6), R"(
 Physical
  Cell ID  SIR
▌     252    6›
      184
        9    2›

)");
    EXPECT_FALSE(press(Key::Right));
    EXPECT_TRUE(type(U'h'));
    EXPECT_TRUE(press(Key::Left));
    EXPECT_TRUE(press(Key::Left));
    EXPECT_FALSE(press(Key::Left));
}

TEST_F(ColumnTableTest, AnIdentityThatLeavesNoRoomIsScrolledToo) {
    TableContent content = neighbours();
    content.columns[1].isIdentity = true;
    content.columns[2].isIdentity = true;
    table.model().show(content);
    EXPECT_TRUE((draw(30, 6), press(Key::Right)));
    EXPECT_EQ(screen(30, 6), R"(
 Physical   Average
  Cell ID  RSRP dBm  State   …
▌     252    -92.00  camped
      184    -94.00  漢字\x1B
        9    -88.00  barred

)");
}

TEST_F(ColumnTableTest, TheChosenColumnIsScrolledIntoTheWindow) {
    (void)draw(20, 6);
    for (int time = 0; time < 5; ++time) {
        EXPECT_TRUE(type(U'>'));
    }
    EXPECT_NE(screen(20, 6).find("SIR↑"), std::string::npos);
    for (int time = 0; time < 3; ++time) {
        EXPECT_TRUE(type(U'<'));
    }
    EXPECT_NE(screen(20, 6).find("Measured"), std::string::npos);
}

TEST_F(ColumnTableTest, XHidesTheChosenColumnAndCapitalXShowsAll) {
    (void)draw(60, 7);
    table.model().choose(1);
    EXPECT_TRUE(type(U'x'));
    EXPECT_EQ(screen(60, 7).find("Measured"), std::string::npos);
    EXPECT_TRUE(type(U'X'));
    EXPECT_NE(screen(60, 7).find("Measured"), std::string::npos);
    EXPECT_FALSE(type(U'z'));
    EXPECT_FALSE(press(Key::Enter));
}

TEST_F(ColumnTableTest, KeysMoveTheCursorAndTheWindowFollows) {
    showNumbers(20);
    (void)draw(20, 6); // a heading and five rows
    const auto cursorAfter = [this](const KeyEvent& event) {
        EXPECT_TRUE(table.handle(event));
        return table.model().cursor();
    };
    EXPECT_EQ(cursorAfter({.key = Key::Down}), 1U);
    EXPECT_EQ(cursorAfter(typed(U'j')), 2U);
    EXPECT_EQ(cursorAfter({.key = Key::Up}), 1U);
    EXPECT_EQ(cursorAfter(typed(U'k')), 0U);
    EXPECT_EQ(cursorAfter({.key = Key::Up}), 0U);
    EXPECT_EQ(cursorAfter({.key = Key::PageDown}), 4U);
    EXPECT_EQ(cursorAfter({.key = Key::WheelDown}), 7U);
    EXPECT_EQ(table.rowsAbove(), 3U);
    EXPECT_EQ(table.rowsBelow(), 12U);
    EXPECT_EQ(cursorAfter({.key = Key::WheelUp}), 4U);
    EXPECT_EQ(cursorAfter({.key = Key::PageUp}), 0U);
    EXPECT_EQ(cursorAfter({.key = Key::End}), 19U);
    EXPECT_EQ(table.rowsBelow(), 0U);
    EXPECT_EQ(cursorAfter({.key = Key::Home}), 0U);
    EXPECT_EQ(cursorAfter(typed(U'G')), 19U);
    EXPECT_EQ(cursorAfter(typed(U'g')), 0U);
    type(U'G');
    EXPECT_EQ(screen(20, 4), "\n Number\n     17\n     18\n▌    19\n");
}

TEST_F(ColumnTableTest, AClickOpensARowOrSortsByAColumn) {
    (void)draw(60, 7);
    hits.at(5, 3)();
    EXPECT_EQ(opened, (std::vector<std::size_t>{1}));
    EXPECT_EQ(table.model().cursor(), 1U);
    hits.at(12, 0)();
    EXPECT_EQ(table.model().chosenColumn(), 1U);
    EXPECT_FALSE(table.model().isDescending());
    (void)draw(60, 7);
    hits.at(12, 1)();
    EXPECT_TRUE(table.model().isDescending());
    EXPECT_FALSE(hits.at(5, 6)) << "no row";
}

TEST_F(ColumnTableTest, WhatMatchesTheFilterIsUnderlined) {
    table.model().setFilter("BAR");
    const Grid grid = draw(60, 7);
    EXPECT_TRUE(grid.at(31, 2).style.underline);
    EXPECT_FALSE(grid.at(34, 2).style.underline);
}

TEST_F(ColumnTableTest, SecondaryRowsAreDim) {
    TableContent content = neighbours();
    content.rows[1].isSecondary = true;
    table.model().show(content);
    const Grid grid = draw(60, 7);
    EXPECT_TRUE(grid.at(7, 3).style.dim);
    EXPECT_FALSE(grid.at(8, 4).style.dim);
}

TEST_F(ColumnTableTest, AValueBeyondTheEdgeIsCut) {
    table.model().show({{{"A"}, {"B"}}, {{"", {{std::string(30, 'a')}, {"b"}}}}});
    EXPECT_EQ(screen(12, 3), "\n A         …\n▌aaaaaaaaa…\n\n");
    press(Key::Right);
    EXPECT_EQ(screen(12, 3), "\n B\n▌b\n\n");
}

TEST_F(ColumnTableTest, EverySizeCanBeDrawn) {
    table.model().choose(3);
    for (int columns = 0; columns < 70; ++columns) {
        for (int rows = 0; rows < 9; ++rows) {
            (void)draw(columns, rows);
            type(columns % 2 == 0 ? U'l' : U'>');
        }
    }
    table.model().show({});
    EXPECT_EQ(screen(10, 2), "\n\n\n");
    for (const char32_t key : {U'l', U'>', U'<', U'x', U'X', U'r', U'j'}) {
        (void)type(key);
    }
}

} // namespace
} // namespace pallax::terminal
