#include "app/pane/PaneModel.h"
#include "tests/app/pane/PaneNodes.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests

/// The only row of a pane that shows this node.
PaneRow rowOf(NodeRef node) {
    return PaneModel(treeNode("Section", {std::move(node)}), "/Section").row(0);
}

/// The row of a display's only branch.
PaneRow branchRowOf(const PropertyList& object) {
    PathDictionary paths;
    return PaneModel(PallaxModelNode::makeTreeFromObject(Dictionary{{"Branch", object}}, paths),
                     "/")
        .row(0);
}

std::optional<std::size_t> elementsIn(const PropertyList& object) {
    const PaneRow row = branchRowOf(object);
    EXPECT_TRUE(row.isBranch);
    return row.elements;
}

TEST(PaneRowTest, ALeafIsItsNameAndItsText) {
    const PaneRow row = rowOf(leafNode("ARFCN", "17"));
    EXPECT_EQ(row.name, "ARFCN");
    EXPECT_EQ(row.text, "17");
    EXPECT_FALSE(row.isBranch);
    EXPECT_EQ(row.elements, std::nullopt);
}

TEST(PaneRowTest, ADisplayNumberIsTextNumberAndUnit) {
    const PaneRow row = rowOf(leafNode("Power", dbm(-94)));
    EXPECT_EQ(row.text, "-94 dBm");
    EXPECT_EQ(row.number, -94.0);
    EXPECT_EQ(row.unit, "dBm");
}

TEST(PaneRowTest, ARealNumberIsTheValueItselfAndNotItsText) {
    static constexpr NumberFormat kShare{"%.1f%%"};
    const PaneRow row = rowOf(leafNode("Share", DisplayNumber(12.345, kShare)));
    EXPECT_EQ(row.text, "12.3%");
    EXPECT_EQ(row.number, 12.345);
    EXPECT_EQ(row.unit, "%");
}

TEST(PaneRowTest, ANumberWithoutAUnitHasNone) {
    static constexpr NumberFormat kHex{"0x%04X"};
    const PaneRow row = rowOf(leafNode("Area", DisplayNumber(std::int64_t{0x1A2D}, kHex)));
    EXPECT_EQ(row.text, "0x1A2D");
    EXPECT_EQ(row.number, 6701.0);
    EXPECT_EQ(row.unit, "");
}

TEST(PaneRowTest, ATextThatReadsAsANumberIsNotANumber) {
    const PaneRow row = rowOf(leafNode("Power", "-94 dBm"));
    EXPECT_EQ(row.number, std::nullopt);
    EXPECT_EQ(row.unit, "");
}

TEST(PaneRowTest, ABranchIsItsName) {
    const PaneRow row = rowOf(treeNode("Section", {}));
    EXPECT_EQ(row.name, "Section");
    EXPECT_EQ(row.text, std::nullopt);
    EXPECT_EQ(row.number, std::nullopt);
    EXPECT_TRUE(row.isBranch);
    EXPECT_FALSE(row.hasChanged);
}

TEST(PaneRowTest, ABranchThatCameFromAnArraySaysHowManyElementsItHas) {
    EXPECT_EQ(elementsIn(Array{"a"}), 1U);
    EXPECT_EQ(elementsIn(Array(11, PropertyList("x"))), 11U);
    EXPECT_EQ(elementsIn(Array{Dictionary(), Array(), "x"}), 3U);
}

TEST(PaneRowTest, ABranchWithOtherNamesOrNoneIsNoList) {
    EXPECT_EQ(elementsIn(Array()), std::nullopt);
    EXPECT_EQ(elementsIn(Dictionary{{"ARFCN", "17"}}), std::nullopt);
    EXPECT_EQ(elementsIn(Dictionary{{"1", "a"}, {"2", "b"}}), std::nullopt);
    EXPECT_EQ(elementsIn(Dictionary{{"1", "a"}, {"0", "b"}}), std::nullopt);
    EXPECT_EQ(elementsIn(Dictionary{{"0", "a"}, {"1", "b"}, {"x", "c"}}), std::nullopt);
}

TEST(PaneRowTest, ADictionaryWhoseKeysAreNumberedInOrderCountsAsAList) {
    EXPECT_EQ(elementsIn(Dictionary{{"0", "a"}, {"1", "b"}}), 2U);
}

/// A leaf that knows when its value was read.
class ReadLeaf final : public PallaxModelNode {
public:
    explicit ReadLeaf(Time time) : PallaxModelNode("Leaf"), _time(time) {}
    std::optional<Time> readAt() const override { return _time; }

private:
    Time _time;
};

TEST(PaneRowTest, ARowWasReadWhenItsNodeSaysSo) {
    const Time time{std::chrono::seconds(1'700'000'000)};
    EXPECT_EQ(rowOf(std::make_shared<ReadLeaf>(time)).readAt, time);
    EXPECT_EQ(rowOf(leafNode("Leaf", "1")).readAt, std::nullopt);
    EXPECT_EQ(branchRowOf(Array()).readAt, std::nullopt);
}

} // namespace
} // namespace pallax
