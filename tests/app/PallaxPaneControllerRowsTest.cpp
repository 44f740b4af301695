#include "tests/app/PaneFixture.h"
#include "tests/doubles/Property.h"
#include "text/NumberFormat.h"

#include <rapidcheck.h>

#include <algorithm>
#include <set>
#include <utility>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests

DisplayNumber dbm(std::int64_t power) {
    static constexpr NumberFormat kDbm{"%d dBm"};
    return {power, kDbm};
}

class PaneRowsTest : public PaneFixture {
protected:
    /// A pane that has shown `before` and then, reloaded, `now`.
    PaneRef reloaded(std::vector<NodeRef> before, std::vector<NodeRef> now) {
        PaneRef pane = makePane(treeNode("Section", std::move(before)), "/Section");
        pane->reloadWithNode(treeNode("Section", std::move(now)));
        return pane;
    }
    /// Which rows have changed, as "-" and "*".
    static std::string changes(const PallaxPaneController& pane) {
        std::string marks;
        for (std::size_t row = 0; row < pane.numberOfRows(); ++row) {
            marks += pane.textOfRow(row).hasChanged ? '*' : '-';
        }
        return marks;
    }
    /// How many elements the pane says of a branch of that display object.
    std::optional<std::size_t> elementsOf(const PropertyList& object) {
        PathDictionary paths;
        const NodeRef root =
            PallaxModelNode::makeTreeFromObject(Dictionary{{"Branch", object}}, paths);
        const ui::RowText text = makePane(root)->textOfRow(0);
        EXPECT_TRUE(text.isBranch);
        return text.elements;
    }
};

TEST_F(PaneRowsTest, ALeafsTextIsItsNameAndItsValue) {
    const PaneRef pane = makePane(treeNode("Section", {leafNode("ARFCN", "17")}));
    const ui::RowText text = pane->textOfRow(0);
    EXPECT_EQ(text.name, "ARFCN");
    EXPECT_EQ(text.value, "17");
    EXPECT_FALSE(text.isBranch);
    EXPECT_EQ(text.elements, std::nullopt);
}

TEST_F(PaneRowsTest, ADisplayNumbersTextIsMadeWhenItIsAskedFor) {
    const PaneRef pane = makePane(treeNode("Section", {leafNode("Power", dbm(-94))}));
    EXPECT_EQ(pane->textOfRow(0).value, "-94 dBm");
    EXPECT_EQ(cellOf(*pane, 0)->value()->text, "-94 dBm");
}

TEST_F(PaneRowsTest, ABranchsTextIsItsName) {
    const PaneRef pane = makePane(treeNode("Pallax", {treeNode("Section", {})}));
    const ui::RowText text = pane->textOfRow(0);
    EXPECT_EQ(text.name, "Section");
    EXPECT_EQ(text.value, std::nullopt);
    EXPECT_TRUE(text.isBranch);
    EXPECT_FALSE(text.hasChanged);
}

TEST_F(PaneRowsTest, ABranchThatCameFromAnArraySaysHowManyElementsItHas) {
    EXPECT_EQ(elementsOf(Array{"a"}), 1U);
    EXPECT_EQ(elementsOf(Array(11, PropertyList("x"))), 11U);
    EXPECT_EQ(elementsOf(Array{Dictionary(), Array(), "x"}), 3U);
}

TEST_F(PaneRowsTest, ABranchWithOtherNamesOrNoneIsNoList) {
    EXPECT_EQ(elementsOf(Array()), std::nullopt);
    EXPECT_EQ(elementsOf(Dictionary{{"ARFCN", "17"}}), std::nullopt);
    EXPECT_EQ(elementsOf(Dictionary{{"1", "a"}, {"2", "b"}}), std::nullopt);
    EXPECT_EQ(elementsOf(Dictionary{{"1", "a"}, {"0", "b"}}), std::nullopt);
    EXPECT_EQ(elementsOf(Dictionary{{"0", "a"}, {"1", "b"}, {"x", "c"}}), std::nullopt);
}

TEST_F(PaneRowsTest, ADictionaryWhoseKeysAreNumberedInOrderCountsAsAList) {
    EXPECT_EQ(elementsOf(Dictionary{{"0", "a"}, {"1", "b"}}), 2U);
}

TEST_F(PaneRowsTest, NothingHasChangedBeforeTheFirstReload) {
    const PaneRef pane = makePane(treeNode("Section", {leafNode("A", "1")}));
    EXPECT_EQ(changes(*pane), "-");
}

TEST_F(PaneRowsTest, TheFirstDataOfAPaneHaveNotChanged) {
    const PaneRef pane = makePane(nullptr);
    pane->reloadWithNode(treeNode("Pallax", {leafNode("A", "1")}));
    EXPECT_EQ(changes(*pane), "-");
}

TEST_F(PaneRowsTest, ALeafHasChangedWhenItsValueIsAnotherThanBefore) {
    const PaneRef pane = reloaded({leafNode("A", "1"), leafNode("B", "2")},
                                  {leafNode("A", "1"), leafNode("B", "3")});
    EXPECT_EQ(changes(*pane), "-*");
}

TEST_F(PaneRowsTest, AMarkLastsForOneReload) {
    const PaneRef pane = reloaded({leafNode("A", "1")}, {leafNode("A", "2")});
    EXPECT_EQ(changes(*pane), "*");
    pane->reloadWithNode(treeNode("Section", {leafNode("A", "2")}));
    EXPECT_EQ(changes(*pane), "-");
    pane->reloadWithNode(treeNode("Section", {leafNode("A", "1")}));
    EXPECT_EQ(changes(*pane), "*");
}

TEST_F(PaneRowsTest, AReloadWithTheSameNodeIsNoNewData) {
    const PaneRef pane = makePane(treeNode("Section", {leafNode("A", "1")}));
    const NodeRef now = treeNode("Section", {leafNode("A", "2")});
    pane->reloadWithNode(now);
    pane->reloadWithNode(now);
    EXPECT_EQ(changes(*pane), "*");
}

TEST_F(PaneRowsTest, ALeafThatWasNotThereBeforeHasChanged) {
    const PaneRef pane = reloaded({leafNode("A", "1")}, {leafNode("A", "1"), leafNode("B", "2")});
    EXPECT_EQ(changes(*pane), "-*");
}

TEST_F(PaneRowsTest, ALeafThatWasABranchBeforeHasChanged) {
    const PaneRef pane = reloaded({treeNode("A", {})}, {leafNode("A", "1")});
    EXPECT_EQ(changes(*pane), "*");
}

TEST_F(PaneRowsTest, ABranchNeverHasChanged) {
    const PaneRef pane =
        reloaded({leafNode("A", "1")}, {treeNode("A", {leafNode("x", "1")}), treeNode("B", {})});
    EXPECT_EQ(changes(*pane), "--");
}

TEST_F(PaneRowsTest, ARowThatHasMovedIsComparedByItsName) {
    const PaneRef pane = reloaded({leafNode("A", "1"), leafNode("B", "2"), leafNode("C", "3")},
                                  {leafNode("C", "3"), leafNode("A", "1"), leafNode("B", "4")});
    EXPECT_EQ(changes(*pane), "--*");
}

TEST_F(PaneRowsTest, RowsThatMoveAtEachReloadAreComparedWithTheLastOneOnly) {
    const PaneRef pane = reloaded({leafNode("A", "1"), leafNode("B", "2")},
                                  {leafNode("B", "2"), leafNode("A", "5")});
    EXPECT_EQ(changes(*pane), "-*");
    pane->reloadWithNode(treeNode("Section", {leafNode("A", "5"), leafNode("B", "3")}));
    EXPECT_EQ(changes(*pane), "-*");
}

/// A few leaves, each name once, in any order.
std::vector<std::pair<std::string, std::string>> anyLeaves() {
    auto leaves = *rc::gen::container<std::vector<std::pair<std::string, std::string>>>(
        rc::gen::pair(rc::gen::element<std::string>("A", "B", "C", "D", "E"),
                      rc::gen::element<std::string>("1", "2")));
    std::vector<std::pair<std::string, std::string>> unique;
    std::set<std::string> names;
    for (auto& leaf : leaves) {
        if (names.insert(leaf.first).second) {
            unique.push_back(std::move(leaf));
        }
    }
    return unique;
}

TEST_F(PaneRowsTest, WhateverRowsComeGoAndMoveALeafIsComparedWithTheOneOfItsName) {
    const auto nodes = [](const auto& leaves) {
        std::vector<NodeRef> made;
        for (const auto& [name, value] : leaves) {
            made.push_back(leafNode(name, value));
        }
        return made;
    };
    EXPECT_TRUE(doubles::holds([&] {
        const auto before = anyLeaves();
        const auto now = anyLeaves();
        const PaneRef pane = reloaded(nodes(before), nodes(now));
        for (std::size_t row = 0; row < now.size(); ++row) {
            const bool unchanged =
                std::find(before.begin(), before.end(), now[row]) != before.end();
            RC_ASSERT(pane->textOfRow(row).hasChanged != unchanged);
        }
    }));
}

TEST_F(PaneRowsTest, RowsWithOneNameAreComparedInTheirPlaces) {
    const PaneRef pane = reloaded({leafNode("A", "1"), leafNode("A", "2")},
                                  {leafNode("A", "1"), leafNode("A", "2")});
    EXPECT_EQ(changes(*pane), "--");
}

TEST_F(PaneRowsTest, OfTwoRowsWithOneNameTheLaterIsFoundByName) {
    const PaneRef pane = reloaded({leafNode("A", "1"), leafNode("A", "2")},
                                  {leafNode("B", "0"), leafNode("C", "0"), leafNode("A", "2")});
    EXPECT_EQ(changes(*pane), "**-");
}

TEST_F(PaneRowsTest, ANumberAndAStringOfTheSameTextAreTheSameValue) {
    const PaneRef pane = reloaded({leafNode("A", "-94 dBm"), leafNode("B", "-94 dBm")},
                                  {leafNode("A", dbm(-94)), leafNode("B", dbm(-95))});
    EXPECT_EQ(changes(*pane), "-*");
}

TEST_F(PaneRowsTest, AfterAPaneWithoutANodeNothingHasChanged) {
    const PaneRef pane = reloaded({leafNode("A", "1")}, {leafNode("A", "2")});
    pane->reloadWithNode(nullptr);
    pane->reloadWithNode(treeNode("Section", {leafNode("A", "3")}));
    EXPECT_EQ(changes(*pane), "-");
}

TEST_F(PaneRowsTest, ALeafShownBeforeAsANodeWithoutChildrenLeavesAllRowsNew) {
    const PaneRef pane = makePane(leafNode("Section", "1"));
    pane->reloadWithNode(treeNode("Section", {leafNode("A", "1")}));
    EXPECT_EQ(changes(*pane), "*");
}

/// A leaf that counts how often a value is looked at.
class CountingLeaf final : public PallaxModelNode {
public:
    CountingLeaf(std::string name, PropertyList value, int& looks)
        : PallaxModelNode(std::move(name)), _value(std::move(value)), _looks(looks) {}
    const PropertyList* value() const override {
        ++_looks;
        return &_value;
    }

private:
    PropertyList _value;
    int& _looks;
};

TEST_F(PaneRowsTest, NothingIsDoneForRowsThatAreNotAskedFor) {
    constexpr int kRows = 50000;
    int looks = 0;
    const auto section = [&looks](const char* value) {
        std::vector<NodeRef> leaves;
        leaves.reserve(kRows);
        for (int row = 0; row < kRows; ++row) {
            leaves.push_back(
                std::make_shared<CountingLeaf>("leaf " + std::to_string(row), value, looks));
        }
        return treeNode("Section", std::move(leaves));
    };
    const PaneRef pane = makePane(section("1"));
    pane->reloadWithNode(section("2"));
    EXPECT_EQ(looks, 0);
    EXPECT_TRUE(pane->textOfRow(kRows - 1).hasChanged);
    EXPECT_EQ(looks, 3) << "its text, then one look at either value";
}

} // namespace
} // namespace pallax
