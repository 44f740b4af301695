#include "app/pane/PaneModel.h"

#include "tests/app/pane/PaneNodes.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests

class PaneModelTest : public testing::Test {
protected:
    void show(std::initializer_list<const char*> names) { pane.show(sectionOf(names)); }

    /// The names of the shown rows, with the cursor's in brackets.
    std::string shown() const {
        std::string text;
        for (std::size_t at = 0; at < pane.shownRows(); ++at) {
            const std::string name = pane.row(pane.rowAt(at)).name;
            text += (at == 0 ? "" : " ") + (at == pane.cursor() ? "[" + name + "]" : name);
        }
        return text;
    }

    PaneModel pane{sectionOf({"A", "B", "C", "D", "E"}), "/Section"};
};

TEST_F(PaneModelTest, HasTheNameOfItsNodeAndItsPath) {
    EXPECT_EQ(pane.title(), "Section");
    EXPECT_EQ(pane.path(), "/Section");
    pane.show(treeNode("Other", {}));
    EXPECT_EQ(pane.title(), "Other");
    EXPECT_EQ(pane.path(), "/Section");
}

TEST_F(PaneModelTest, WithoutANodeItIsEmptyAndNamedPallax) {
    const PaneModel empty(nullptr, "/");
    EXPECT_EQ(empty.title(), "Pallax");
    EXPECT_EQ(empty.totalRows(), 0U);
    EXPECT_EQ(empty.shownRows(), 0U);
    EXPECT_EQ(empty.nodeAt(0), nullptr);
    EXPECT_EQ(empty.row(0).name, "");
    EXPECT_EQ(empty.row(0).text, std::nullopt);
    EXPECT_EQ(empty.cursor(), 0U);
    EXPECT_EQ(empty.cursorRow(), std::nullopt);
    EXPECT_EQ(empty.copied(), std::nullopt);
}

TEST_F(PaneModelTest, ALeafAsItsNodeHasNoRows) {
    pane.show(leafNode("ARFCN", "17"));
    EXPECT_EQ(pane.totalRows(), 0U);
    EXPECT_EQ(pane.cursorRow(), std::nullopt);
}

TEST_F(PaneModelTest, IsLoadingWithoutAStatusUntilItIsTold) {
    EXPECT_EQ(pane.status(), "");
    EXPECT_TRUE(pane.isLoading());
    pane.setStatus("Updated", false);
    EXPECT_EQ(pane.status(), "Updated");
    EXPECT_FALSE(pane.isLoading());
}

TEST_F(PaneModelTest, TheCursorStandsOnTheFirstRowAtFirst) {
    EXPECT_EQ(shown(), "[A] B C D E");
    EXPECT_EQ(pane.cursorRow(), 0U);
}

TEST_F(PaneModelTest, TheCursorStopsAtTheLastRow) {
    pane.moveCursorTo(3);
    EXPECT_EQ(shown(), "A B C [D] E");
    pane.moveCursorTo(99);
    EXPECT_EQ(shown(), "A B C D [E]");
}

TEST_F(PaneModelTest, TheCursorStaysOnItsRowWhenRowsCome) {
    pane.moveCursorTo(2);
    show({"0", "1", "A", "B", "C", "D", "E"});
    EXPECT_EQ(shown(), "0 1 A B [C] D E");
}

TEST_F(PaneModelTest, ACursorThatWasNeverMovedStaysOnItsRowToo) {
    show({"0", "A", "B"});
    EXPECT_EQ(shown(), "0 [A] B");
}

TEST_F(PaneModelTest, TheCursorStaysOnItsRowWhenRowsGo) {
    pane.moveCursorTo(3);
    show({"B", "D"});
    EXPECT_EQ(shown(), "B [D]");
}

TEST_F(PaneModelTest, TheCursorStaysOnItsRowWhenRowsMove) {
    pane.moveCursorTo(1);
    show({"E", "D", "C", "B", "A"});
    EXPECT_EQ(shown(), "E D C [B] A");
}

TEST_F(PaneModelTest, OfSeveralRowsOfItsNameTheNearestIsTaken) {
    show({"X", "-", "-", "-", "X"});
    pane.moveCursorTo(4);
    show({"X", "-", "-", "X", "-", "-", "X"});
    EXPECT_EQ(pane.cursor(), 3U);
    show({"X", "-", "-", "-", "-", "X"});
    EXPECT_EQ(pane.cursor(), 5U);
}

TEST_F(PaneModelTest, WhereItsRowIsGoneTheCursorStaysAtItsPlace) {
    pane.moveCursorTo(2);
    show({"A", "B", "D", "E"});
    EXPECT_EQ(shown(), "A B [D] E");
    show({"0", "A", "B", "D", "E"});
    EXPECT_EQ(shown(), "0 A B [D] E");
}

TEST_F(PaneModelTest, WhereItsRowAndItsPlaceAreGoneTheCursorStandsOnTheLast) {
    pane.moveCursorTo(4);
    show({"A", "B"});
    EXPECT_EQ(shown(), "A [B]");
}

TEST_F(PaneModelTest, TheCursorComesBackToItsRowWhenAllRowsWereGone) {
    pane.moveCursorTo(2);
    pane.show(nullptr);
    EXPECT_EQ(pane.cursorRow(), std::nullopt);
    pane.moveCursorTo(1);
    show({"A", "B", "C", "D"});
    EXPECT_EQ(shown(), "A B [C] D");
}

TEST_F(PaneModelTest, TheCursorComesBackToItsRowWhenNoRowPassedTheFilter) {
    pane.moveCursorTo(3);
    pane.setFilter("no such row");
    EXPECT_EQ(pane.shownRows(), 0U);
    EXPECT_EQ(pane.cursorRow(), std::nullopt);
    pane.setFilter("");
    EXPECT_EQ(shown(), "A B C [D] E");
}

TEST_F(PaneModelTest, AFilterKeepsRowsByNameOrValueInAnyCase) {
    pane.show(treeNode("Section", {leafNode("Measured RSRP", dbm(-94)), leafNode("Version", "1"),
                                   leafNode("Kind", "Average rsrp"), treeNode("Cells", {})}));
    pane.setFilter("RsRp");
    EXPECT_EQ(pane.filter(), "RsRp");
    EXPECT_EQ(pane.totalRows(), 4U);
    EXPECT_EQ(shown(), "[Measured RSRP] Kind");
    pane.setFilter("94 DBM");
    EXPECT_EQ(shown(), "[Measured RSRP]");
    pane.setFilter("cell");
    EXPECT_EQ(shown(), "[Cells]");
    EXPECT_EQ(pane.cursorRow(), 3U);
    pane.setFilter("");
    EXPECT_EQ(pane.shownRows(), 4U);
}

TEST_F(PaneModelTest, TheCursorStaysOnItsRowUnderAFilterAndAfterIt) {
    show({"xA", "B", "xC", "D", "xE"});
    pane.moveCursorTo(4);
    pane.setFilter("x");
    EXPECT_EQ(shown(), "xA xC [xE]");
    pane.moveCursorTo(1);
    pane.setFilter("");
    EXPECT_EQ(pane.cursorRow(), 2U);
}

TEST_F(PaneModelTest, AFilterHoldsForNewData) {
    show({"xA", "B", "xC"});
    pane.setFilter("x");
    pane.moveCursorTo(1);
    show({"B", "x0", "xA", "B2", "xC", "x9"});
    EXPECT_EQ(shown(), "x0 xA [xC] x9");
    EXPECT_EQ(pane.cursorRow(), 4U);
}

TEST_F(PaneModelTest, OfARowItsValueIsCopiedAndOfABranchItsName) {
    pane.show(treeNode("Section", {leafNode("Power", dbm(-94)), treeNode("Cells", {})}));
    EXPECT_EQ(pane.copied(), "-94 dBm");
    pane.moveCursorTo(1);
    EXPECT_EQ(pane.copied(), "Cells");
    pane.setFilter("power");
    EXPECT_EQ(pane.copied(), "-94 dBm");
    pane.setFilter("no such row");
    EXPECT_EQ(pane.copied(), std::nullopt);
}

TEST_F(PaneModelTest, WhateverHappensTheCursorIsOnARow) {
    EXPECT_TRUE(doubles::holds([this] {
        using By = PaneOrder::By;
        constexpr auto kNames = std::to_array<const char*>({"A", "B", "C", "xA", "xB", "xC"});
        constexpr auto kFilters = std::to_array<const char*>({"", "x", "a", "q"});
        const int steps = any::between(1, 30);
        for (int step = 0; step < steps; ++step) {
            switch (any::between(0, 4)) {
            case 0: {
                std::vector<NodeRef> rows;
                for (const int name : any::integers(0, static_cast<int>(kNames.size()))) {
                    rows.push_back(leafNode(kNames.at(static_cast<std::size_t>(name)),
                                            any::boolean() ? "1" : "2"));
                }
                pane.show(treeNode("Section", std::move(rows)));
                break;
            }
            case 1:
                pane.moveCursorTo(any::index(9));
                break;
            case 2:
                pane.setFilter(any::elementOf(kFilters));
                break;
            default:
                pane.setOrder({any::elementOf(std::to_array({By::Display, By::Name, By::Value})),
                               any::boolean()});
                break;
            }
            const std::size_t count = pane.shownRows();
            RC_ASSERT(count <= pane.totalRows());
            RC_ASSERT((pane.cursor() < count || (count == 0 && pane.cursor() == 0U)));
            RC_ASSERT((count == 0 || pane.cursorRow().value() < pane.totalRows()));
        }
    }));
}

} // namespace
} // namespace pallax
