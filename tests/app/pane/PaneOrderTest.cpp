#include "app/pane/PaneModel.h"
#include "tests/app/pane/PaneNodes.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <limits>
#include <numeric>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using By = PaneOrder::By;

/// The names of the shown rows, in their order.
std::string shown(const PaneModel& pane) {
    std::string names;
    for (std::size_t at = 0; at < pane.shownRows(); ++at) {
        names += (at == 0 ? "" : " ") + pane.row(pane.rowAt(at)).name;
    }
    return names;
}

std::string inOrder(const std::vector<NodeRef>& children, PaneOrder order) {
    PaneModel pane(treeNode("Section", children), "/Section");
    pane.setOrder(order);
    return shown(pane);
}

TEST(PaneOrderTest, RowsAreInTheDisplaysOrderAtFirstAndInReverseIfDescending) {
    const std::vector<NodeRef> rows{leafNode("B", "1"), leafNode("A", "2"), leafNode("C", "0")};
    EXPECT_EQ(inOrder(rows, {}), "B A C");
    EXPECT_EQ(inOrder(rows, {By::Display, true}), "C A B");
}

TEST(PaneOrderTest, ByNameTheBytesCount) {
    const std::vector<NodeRef> rows{leafNode("b", "1"), leafNode("B", "2"), leafNode("10", "0"),
                                    treeNode("é", {}), leafNode("2", "0")};
    EXPECT_EQ(inOrder(rows, {By::Name}), "10 2 B b é");
    EXPECT_EQ(inOrder(rows, {By::Name, true}), "é b B 2 10");
}

TEST(PaneOrderTest, ByValueNumbersComeByTheirSizeThenTextsThenBranches) {
    static constexpr NumberFormat kReal{"%.2f dB"};
    const std::vector<NodeRef> rows{
        treeNode("branch", {}),         leafNode("text b", "-100 dBm"),
        leafNode("minus 9", dbm(-9)),   leafNode("text a", ""),
        leafNode("minus 10", dbm(-10)), leafNode("minus 9.5", DisplayNumber(-9.5, kReal))};
    EXPECT_EQ(inOrder(rows, {By::Value}), "minus 10 minus 9.5 minus 9 text a text b branch");
    EXPECT_EQ(inOrder(rows, {By::Value, true}), "minus 9 minus 9.5 minus 10 text b text a branch");
}

TEST(PaneOrderTest, EqualRowsKeepTheDisplaysOrderBothWays) {
    const std::vector<NodeRef> rows{leafNode("c", dbm(1)), leafNode("a", dbm(1)),
                                    leafNode("b", dbm(0))};
    EXPECT_EQ(inOrder(rows, {By::Value}), "b c a");
    EXPECT_EQ(inOrder(rows, {By::Value, true}), "c a b");
    PaneModel many(treeNode("Section", std::vector<NodeRef>(100, leafNode("A", dbm(1)))), "/");
    many.setOrder({By::Value, true});
    for (std::size_t row = 0; row < many.shownRows(); ++row) {
        EXPECT_EQ(many.rowAt(row), row);
    }
}

TEST(PaneOrderTest, WhatIsNoNumberStandsAmongTheTexts) {
    static constexpr NumberFormat kReal{"%.2f"};
    constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
    const std::vector<NodeRef> rows{leafNode("nan", DisplayNumber(kNaN, kReal)),
                                    leafNode("one", DisplayNumber(1.0, kReal))};
    EXPECT_EQ(inOrder(rows, {By::Value}), "one nan");
}

TEST(PaneOrderTest, AnOrderHoldsForNewDataAndUnderAFilter) {
    PaneModel pane(treeNode("Section", {leafNode("xA", dbm(3)), leafNode("xB", dbm(2)),
                                        leafNode("C", dbm(1))}),
                   "/Section");
    pane.setOrder({By::Value});
    pane.setFilter("x");
    EXPECT_EQ(shown(pane), "xB xA");
    pane.show(treeNode("Section", {leafNode("xA", dbm(1)), leafNode("xB", dbm(2)),
                                   leafNode("xD", dbm(0)), leafNode("C", dbm(-1))}));
    EXPECT_EQ(shown(pane), "xD xA xB");
    EXPECT_EQ(pane.order(), PaneOrder{By::Value});
    pane.setOrder({});
    EXPECT_EQ(shown(pane), "xA xB xD");
}

TEST(PaneOrderTest, TheCursorGoesWithItsRow) {
    PaneModel pane(
        treeNode("Section", {leafNode("A", dbm(3)), leafNode("B", dbm(2)), leafNode("C", dbm(1))}),
        "/Section");
    pane.setOrder({By::Value});
    EXPECT_EQ(pane.cursor(), 2U);
    EXPECT_EQ(pane.cursorRow(), 0U);
    pane.show(
        treeNode("Section", {leafNode("A", dbm(0)), leafNode("B", dbm(2)), leafNode("C", dbm(1))}));
    EXPECT_EQ(pane.cursor(), 0U);
    EXPECT_EQ(pane.cursorRow(), 0U);
}

TEST(PaneOrderTest, InAnyOrderEveryRowIsShownOnce) {
    EXPECT_TRUE(doubles::holds([] {
        std::vector<NodeRef> rows;
        const std::vector<int> numbers = any::integers(-3, 3);
        for (const int number : numbers) {
            rows.push_back(number < 0 ? leafNode("text", std::to_string(number))
                                      : leafNode("number", dbm(number)));
        }
        PaneModel pane(treeNode("Section", rows), "/Section");
        pane.setOrder(
            {any::elementOf(std::to_array({By::Display, By::Name, By::Value})), any::boolean()});
        std::vector<std::size_t> order;
        for (std::size_t at = 0; at < pane.shownRows(); ++at) {
            order.push_back(pane.rowAt(at));
        }
        std::sort(order.begin(), order.end());
        std::vector<std::size_t> all(rows.size());
        std::iota(all.begin(), all.end(), 0U);
        RC_ASSERT(order == all);
    }));
}

} // namespace
} // namespace pallax
