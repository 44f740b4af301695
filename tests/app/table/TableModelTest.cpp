#include "app/table/TableModel.h"

#include <gtest/gtest.h>

#include <limits>

namespace pallax {
namespace {

using Changes = TableModel::Changes;

TableCell number(double value, const char* text) {
    return {text, value, false};
}
TableCell text(const char* value) {
    return {value};
}

/// Three cells: a code, a level in dBm and a state.
TableContent cells(double firstLevel = -91, const char* firstText = "-91") {
    return {{{"PCI", "", true}, {"RSRP", "dBm"}, {"State"}},
            {{"252", {number(252, "252"), number(firstLevel, firstText), text("camped")}},
             {"184", {number(184, "184"), number(-104, "-104"), text("")}},
             {"9", {number(9, "9"), number(-88, "-88"), text("barred")}}},
            "cell",
            "cells"};
}

class TableModelTest : public testing::Test {
protected:
    TableModelTest() { model.show(cells()); }
    /// The keys of the shown rows.
    std::string keys() const {
        std::string all;
        for (std::size_t shown = 0; shown < model.shownRows(); ++shown) {
            all += model.content().rows[model.rowAt(shown)].key + " ";
        }
        return all;
    }
    std::string cursorKey() const {
        const auto row = model.cursorRow();
        return row ? model.content().rows[*row].key : "(none)";
    }
    /// The changed cells, row by row.
    std::string changes() const {
        std::string all;
        for (std::size_t row = 0; row < model.content().rows.size(); ++row) {
            for (std::size_t column = 0; column < model.content().columns.size(); ++column) {
                all += model.hasChanged(row, column) ? "*" : "-";
            }
            all += " ";
        }
        return all;
    }

    TableModel model;
};

TEST_F(TableModelTest, BeginsInTheOrderOfTheContent) {
    EXPECT_EQ(keys(), "252 184 9 ");
    EXPECT_EQ(cursorKey(), "252");
    EXPECT_EQ(model.chosenColumn(), std::nullopt);
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0, 1, 2}));
    EXPECT_EQ(changes(), "--- --- --- ");
}

TEST_F(TableModelTest, SortsNumbersAsNumbersAndKeepsTheCursorOnItsRow) {
    model.chooseNext();
    EXPECT_EQ(keys(), "9 184 252 ");
    EXPECT_EQ(cursorKey(), "252");
    EXPECT_EQ(model.cursor(), 2U);
    model.chooseNext();
    EXPECT_EQ(keys(), "184 252 9 ");
    model.reverse();
    EXPECT_EQ(keys(), "9 252 184 ");
    EXPECT_TRUE(model.isDescending());
}

TEST_F(TableModelTest, RowsWithoutAValueAreLastInBothDirections) {
    model.choose(2);
    EXPECT_EQ(keys(), "9 252 184 ");
    model.reverse();
    EXPECT_EQ(keys(), "252 9 184 ");
}

TEST_F(TableModelTest, NumbersComeBeforeTextsAndANumberThatIsNoneIsAText) {
    constexpr double kNan = std::numeric_limits<double>::quiet_NaN();
    model.show({{{"A"}},
                {{"t", {text("b")}},
                 {"n", {number(kNan, "a")}},
                 {"2", {number(2, "2")}},
                 {"10", {number(10, "10")}},
                 {"", {text("")}}}});
    model.choose(0);
    EXPECT_EQ(keys(), "2 10 n t  ");
    model.reverse();
    EXPECT_EQ(keys(), "10 2 t n  ");
}

TEST_F(TableModelTest, BeforeTheFirstColumnIsTheOrderOfTheContent) {
    model.choosePrevious(); // none is chosen
    model.chooseNext();
    model.chooseNext();
    model.choosePrevious();
    EXPECT_EQ(model.chosenColumn(), 0U);
    model.choosePrevious();
    EXPECT_EQ(model.chosenColumn(), std::nullopt);
    EXPECT_EQ(keys(), "252 184 9 ");
    for (int time = 0; time < 5; ++time) {
        model.chooseNext();
    }
    EXPECT_EQ(model.chosenColumn(), 2U);
}

TEST_F(TableModelTest, HidesAnyColumn) {
    model.choose(2);
    model.hide(0);
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{1, 2}));
    EXPECT_EQ(model.chosenColumn(), 2U) << "another one";
    model.hide(2);
    EXPECT_EQ(model.chosenColumn(), 1U) << "its neighbour";
    model.hide(1);
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{1})) << "the last one stays";
}

TEST_F(TableModelTest, HidesTheChosenColumnAndChoosesItsNeighbour) {
    model.hideChosen(); // none is chosen
    EXPECT_FALSE(model.hidesColumns());
    model.choose(1);
    model.hideChosen();
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0, 2}));
    EXPECT_EQ(model.chosenColumn(), 2U);
    EXPECT_EQ(keys(), "9 252 184 ");
    model.hideChosen();
    EXPECT_EQ(model.chosenColumn(), 0U);
    model.hideChosen(); // the last one stays
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0}));
    model.update(cells(), Changes::Ignore);
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0}));
    model.showAllColumns();
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0, 1, 2}));
}

/// The cells with an extra column.
TableContent agedCells(const char* firstAge = "4 s") {
    TableContent content = cells();
    content.columns.push_back({"age", "", false, true});
    content.rows[0].cells.push_back(number(4, firstAge));
    content.rows[1].cells.push_back(number(1, "1 s"));
    content.rows[2].cells.push_back(number(180, "3 min"));
    return content;
}

TEST_F(TableModelTest, AnExtraColumnIsShownWhileItIsChosen) {
    model.show(agedCells());
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0, 1, 2}));
    model.choose(2);
    model.chooseNext();
    EXPECT_EQ(model.chosenColumn(), 3U);
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0, 1, 2, 3}));
    EXPECT_EQ(keys(), "184 252 9 ");
    EXPECT_EQ(model.copied(), "4 s") << "the cursor has kept to its row";
    model.reverse();
    EXPECT_EQ(keys(), "9 252 184 ");
    model.choosePrevious();
    EXPECT_EQ(model.chosenColumn(), 2U);
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0, 1, 2}));
    model.showAllColumns();
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0, 1, 2, 3}));
    model.show(agedCells());
    EXPECT_EQ(model.columns(), (std::vector<std::size_t>{0, 1, 2}));
}

TEST_F(TableModelTest, AnExtraColumnIsNeitherSearchedNorMarkedNorCopiedWithItsRow) {
    model.show(agedCells());
    model.setFilter("3 min");
    EXPECT_EQ(keys(), "");
    model.setFilter("");
    model.update(agedCells("6 s"), Changes::Mark);
    EXPECT_EQ(changes(), "---- ---- ---- ");
    TableContent content = agedCells();
    content.columns[0].isIdentity = false;
    model.show(content);
    EXPECT_EQ(model.copied(), "252\t-91 dBm\tcamped");
}

TEST_F(TableModelTest, TheCellsOfAColumnCanBeReplaced) {
    model.show(agedCells());
    model.choose(3);
    model.moveCursorTo(0);
    EXPECT_EQ(cursorKey(), "184");
    const std::uint64_t version = model.version();
    model.setCells(3, {number(1, "1 s"), number(5, "5 s"), number(200, "3 min")});
    EXPECT_EQ(keys(), "252 184 9 ");
    EXPECT_EQ(cursorKey(), "184");
    EXPECT_NE(model.version(), version);
}

TEST_F(TableModelTest, TheFilterIsAnyCellIgnoringCase) {
    model.setFilter("BARR");
    EXPECT_EQ(keys(), "9 ");
    EXPECT_EQ(cursorKey(), "9");
    model.setFilter("-1");
    EXPECT_EQ(keys(), "184 ");
    model.setFilter("nothing");
    EXPECT_EQ(model.cursorRow(), std::nullopt);
    EXPECT_EQ(model.copied(), std::nullopt);
    model.setFilter("");
    EXPECT_EQ(keys(), "252 184 9 ");
}

TEST_F(TableModelTest, TheCursorFollowsItsRowAcrossContents) {
    model.select(1);
    TableContent later = cells();
    std::swap(later.rows[0], later.rows[1]);
    later.rows.insert(later.rows.begin(), {"7", {number(7, "7"), text(""), text("")}});
    model.update(later, Changes::Ignore);
    EXPECT_EQ(cursorKey(), "184");
    EXPECT_EQ(model.cursor(), 1U);
    later.rows.erase(later.rows.begin() + 1);
    model.update(later, Changes::Ignore);
    EXPECT_EQ(cursorKey(), "252") << "the row at its place";
    model.update({}, Changes::Ignore);
    EXPECT_EQ(cursorKey(), "(none)");
    model.update(later, Changes::Ignore);
    EXPECT_EQ(cursorKey(), "252");
}

TEST_F(TableModelTest, OfRowsWithOneKeyTheCursorKeepsToTheNearest) {
    TableContent same = cells();
    for (TableRow& row : same.rows) {
        row.key = "same";
    }
    model.show(same);
    model.moveCursorTo(1);
    model.update(same, Changes::Ignore);
    EXPECT_EQ(model.cursor(), 1U);
    model.moveCursorTo(99);
    EXPECT_EQ(model.cursor(), 2U);
}

TEST_F(TableModelTest, MarksCellsThatDifferFromTheRowOfTheirKey) {
    TableContent later = cells(-92, "-92");
    std::swap(later.rows[0], later.rows[2]);
    model.update(later, Changes::Mark);
    EXPECT_EQ(changes(), "--- --- -*- ");
    model.update(later, Changes::Mark);
    EXPECT_EQ(changes(), "--- --- --- ");
    model.update(cells(), Changes::Ignore);
    EXPECT_EQ(changes(), "--- --- --- ");
}

TEST_F(TableModelTest, EveryValueOfANewRowOrColumnHasChanged) {
    TableContent later = cells();
    later.rows[1].key = "185";
    model.update(later, Changes::Mark);
    EXPECT_EQ(changes(), "--- **- --- ") << "a missing value is no change";
    later.columns[1].name = "RSRQ";
    model.update(later, Changes::Mark);
    EXPECT_EQ(changes(), "-*- -*- -*- ");
}

TEST_F(TableModelTest, OfRowsWithOneKeyEachIsComparedWithItsOwn) {
    TableContent same{{{"A"}}, {{"k", {text("1")}}, {"k", {text("2")}}}};
    model.show(same);
    model.update(same, Changes::Mark);
    EXPECT_EQ(changes(), "- - ");
    same.rows.push_back({"k", {text("3")}});
    model.update(same, Changes::Mark);
    EXPECT_EQ(changes(), "- - * ");
}

TEST_F(TableModelTest, AChosenColumnMayVanishAndReturn) {
    model.choose(1);
    TableContent without = cells();
    without.columns.erase(without.columns.begin() + 1);
    for (TableRow& row : without.rows) {
        row.cells.erase(row.cells.begin() + 1);
    }
    model.update(without, Changes::Ignore);
    EXPECT_EQ(model.chosenColumn(), std::nullopt);
    EXPECT_EQ(keys(), "252 184 9 ");
    model.update(cells(), Changes::Ignore);
    EXPECT_EQ(model.chosenColumn(), 1U);
    EXPECT_EQ(keys(), "184 252 9 ");
}

TEST_F(TableModelTest, CopiesTheIdentityOrTheChosenValueWithItsUnit) {
    EXPECT_EQ(model.copied(), "252");
    model.choose(1);
    EXPECT_EQ(model.copied(), "-91 dBm");
    model.choose(2);
    model.select(1);
    EXPECT_EQ(model.copied(), std::nullopt) << "it has no value there";
}

TEST_F(TableModelTest, AnotherTableBeginsAnew) {
    model.choose(1);
    model.reverse();
    model.hideChosen();
    model.setFilter("9");
    model.moveCursorTo(1);
    const std::uint64_t version = model.version();
    model.show(cells());
    EXPECT_NE(model.version(), version);
    EXPECT_EQ(model.chosenColumn(), std::nullopt);
    EXPECT_FALSE(model.isDescending());
    EXPECT_FALSE(model.hidesColumns());
    EXPECT_EQ(model.filter(), "");
    EXPECT_EQ(model.cursor(), 0U);
}

TEST_F(TableModelTest, ColumnsOfOneNameAreHiddenTogether) {
    model.show({{{"A"}, {"A"}}, {{"1", {text("x"), text("y")}}}});
    model.choose(0);
    model.hideChosen();
    EXPECT_TRUE(model.columns().empty());
    model.chooseNext();
    model.showAllColumns();
    EXPECT_EQ(model.columns().size(), 2U);
}

TEST_F(TableModelTest, WithoutAnIdentityTheWholeRowIsCopied) {
    TableContent content = cells();
    content.columns[0].isIdentity = false;
    model.show(content);
    EXPECT_EQ(model.copied(), "252\t-91 dBm\tcamped");
    model.show({{{"A"}}, {{"", {text("")}}}});
    EXPECT_EQ(model.copied(), std::nullopt);
}

} // namespace
} // namespace pallax
