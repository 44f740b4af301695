#include "app/pane/PaneModel.h"
#include "tests/app/pane/PaneNodes.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>
#include <utility>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests

/// A pane that has shown `before`, then `now`.
PaneModel reloaded(std::vector<NodeRef> before, std::vector<NodeRef> now) {
    PaneModel pane(treeNode("Section", std::move(before)), "/Section");
    pane.show(treeNode("Section", std::move(now)));
    return pane;
}

/// The changed rows as "*", the others as "-".
std::string changes(const PaneModel& pane) {
    std::string marks;
    for (std::size_t row = 0; row < pane.totalRows(); ++row) {
        marks += pane.row(row).hasChanged ? '*' : '-';
    }
    return marks;
}

TEST(PaneChangesTest, NothingHasChangedBeforeTheFirstReload) {
    PaneModel pane(treeNode("Section", {leafNode("A", "1")}), "/Section");
    EXPECT_EQ(changes(pane), "-");
}

TEST(PaneChangesTest, TheFirstDataOfAPaneHaveNotChanged) {
    PaneModel pane(nullptr, "/Section");
    pane.show(treeNode("Pallax", {leafNode("A", "1")}));
    EXPECT_EQ(changes(pane), "-");
}

TEST(PaneChangesTest, ALeafHasChangedWhenItsValueIsAnotherThanBefore) {
    PaneModel pane = reloaded({leafNode("A", "1"), leafNode("B", "2")},
                              {leafNode("A", "1"), leafNode("B", "3")});
    EXPECT_EQ(changes(pane), "-*");
}

TEST(PaneChangesTest, AMarkLastsForOneReload) {
    PaneModel pane = reloaded({leafNode("A", "1")}, {leafNode("A", "2")});
    EXPECT_EQ(changes(pane), "*");
    pane.show(treeNode("Section", {leafNode("A", "2")}));
    EXPECT_EQ(changes(pane), "-");
    pane.show(treeNode("Section", {leafNode("A", "1")}));
    EXPECT_EQ(changes(pane), "*");
}

TEST(PaneChangesTest, AReloadWithTheSameNodeIsNoNewData) {
    PaneModel pane(treeNode("Section", {leafNode("A", "1")}), "/Section");
    const NodeRef now = treeNode("Section", {leafNode("A", "2")});
    pane.show(now);
    pane.show(now);
    EXPECT_EQ(changes(pane), "*");
}

TEST(PaneChangesTest, ALeafThatWasNotThereBeforeHasChanged) {
    PaneModel pane = reloaded({leafNode("A", "1")}, {leafNode("A", "1"), leafNode("B", "2")});
    EXPECT_EQ(changes(pane), "-*");
}

TEST(PaneChangesTest, ALeafThatWasABranchBeforeHasChanged) {
    PaneModel pane = reloaded({treeNode("A", {})}, {leafNode("A", "1")});
    EXPECT_EQ(changes(pane), "*");
}

TEST(PaneChangesTest, ABranchNeverHasChanged) {
    PaneModel pane =
        reloaded({leafNode("A", "1")}, {treeNode("A", {leafNode("x", "1")}), treeNode("B", {})});
    EXPECT_EQ(changes(pane), "--");
}

TEST(PaneChangesTest, ARowThatHasMovedIsComparedByItsName) {
    PaneModel pane = reloaded({leafNode("A", "1"), leafNode("B", "2"), leafNode("C", "3")},
                              {leafNode("C", "3"), leafNode("A", "1"), leafNode("B", "4")});
    EXPECT_EQ(changes(pane), "--*");
}

TEST(PaneChangesTest, RowsThatMoveAtEachReloadAreComparedWithTheLastOneOnly) {
    PaneModel pane = reloaded({leafNode("A", "1"), leafNode("B", "2")},
                              {leafNode("B", "2"), leafNode("A", "5")});
    EXPECT_EQ(changes(pane), "-*");
    pane.show(treeNode("Section", {leafNode("A", "5"), leafNode("B", "3")}));
    EXPECT_EQ(changes(pane), "-*");
}

/// A few leaves with different names in any order.
std::vector<std::pair<std::string, std::string>> anyLeaves() {
    constexpr int kNames = 5;
    std::vector<std::pair<std::string, std::string>> unique;
    std::set<std::string> names;
    for (const int place : any::integers(0, kNames)) {
        const std::string name(1, static_cast<char>('A' + place));
        if (names.insert(name).second) {
            unique.emplace_back(name, any::boolean() ? "1" : "2");
        }
    }
    return unique;
}

TEST(PaneChangesTest, ALeafIsComparedWithTheOneOfItsNameWhenRowsComeGoAndMove) {
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
        PaneModel pane = reloaded(nodes(before), nodes(now));
        for (std::size_t row = 0; row < now.size(); ++row) {
            const bool unchanged =
                std::find(before.begin(), before.end(), now[row]) != before.end();
            RC_ASSERT(pane.row(row).hasChanged != unchanged);
        }
    }));
}

TEST(PaneChangesTest, RowsWithOneNameAreComparedInTheirPlaces) {
    PaneModel pane = reloaded({leafNode("A", "1"), leafNode("A", "2")},
                              {leafNode("A", "1"), leafNode("A", "2")});
    EXPECT_EQ(changes(pane), "--");
}

TEST(PaneChangesTest, OfTwoRowsWithOneNameTheLaterIsFoundByName) {
    PaneModel pane = reloaded({leafNode("A", "1"), leafNode("A", "2")},
                              {leafNode("B", "0"), leafNode("C", "0"), leafNode("A", "2")});
    EXPECT_EQ(changes(pane), "**-");
}

TEST(PaneChangesTest, ANumberAndAStringOfTheSameTextAreTheSameValue) {
    PaneModel pane = reloaded({leafNode("A", "-94 dBm"), leafNode("B", "-94 dBm")},
                              {leafNode("A", dbm(-94)), leafNode("B", dbm(-95))});
    EXPECT_EQ(changes(pane), "-*");
}

TEST(PaneChangesTest, AfterAPaneWithoutANodeNothingHasChanged) {
    PaneModel pane = reloaded({leafNode("A", "1")}, {leafNode("A", "2")});
    pane.show(nullptr);
    pane.show(treeNode("Section", {leafNode("A", "3")}));
    EXPECT_EQ(changes(pane), "-");
}

TEST(PaneChangesTest, ALeafShownBeforeAsANodeWithoutChildrenLeavesAllRowsNew) {
    PaneModel pane(leafNode("Section", "1"), "/Section");
    pane.show(treeNode("Section", {leafNode("A", "1")}));
    EXPECT_EQ(changes(pane), "*");
}

/// A leaf that counts how often its value is read.
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

TEST(PaneChangesTest, NothingIsDoneForRowsThatAreNotAskedFor) {
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
    PaneModel pane(section("1"), "/Section");
    pane.show(section("2"));
    EXPECT_EQ(looks, 0);
    EXPECT_TRUE(pane.row(kRows - 1).hasChanged);
    EXPECT_EQ(looks, 4) << "its text, its number, and both values of the comparison";
}

/// The time of a tick.
Time at(int seconds) {
    return Time{std::chrono::seconds(1'700'000'000 + seconds)};
}

/// A pane of the leaves A and B, whose values are set at each tick.
class PaneAgesTest : public testing::Test {
protected:
    void tick(int seconds, const char* a, const char* b) {
        pane.show(treeNode("Section", {leafNode("A", a), leafNode("B", b)}), at(seconds));
    }
    std::optional<Time> changedAt(std::size_t row) const { return pane.row(row).changedAt; }

    PaneModel pane{nullptr, "/Section"};
};

TEST_F(PaneAgesTest, WhenAValueOfTheFirstDataCameIsNotKnown) {
    tick(0, "1", "2");
    EXPECT_EQ(changedAt(0), std::nullopt);
    tick(2, "1", "2");
    EXPECT_EQ(changedAt(0), std::nullopt);
}

TEST_F(PaneAgesTest, AValueAgesFromTheDataThatBroughtIt) {
    tick(0, "1", "2");
    tick(2, "1", "3");
    EXPECT_EQ(changedAt(0), std::nullopt);
    EXPECT_EQ(changedAt(1), at(2));
    tick(4, "5", "3");
    EXPECT_EQ(changedAt(0), at(4));
    EXPECT_EQ(changedAt(1), at(2));
    tick(6, "5", "4");
    EXPECT_EQ(changedAt(0), at(4));
    EXPECT_EQ(changedAt(1), at(6));
}

TEST_F(PaneAgesTest, AValueAgesOnWhereItsRowMovesAndWhereAnotherHasItsName) {
    pane.show(treeNode("Section", {leafNode("A", "1"), leafNode("A", "1")}), at(0));
    pane.show(treeNode("Section", {leafNode("A", "1"), leafNode("A", "2")}), at(2));
    EXPECT_EQ(changedAt(0), std::nullopt);
    EXPECT_EQ(changedAt(1), at(2));
    pane.show(treeNode("Section", {leafNode("A", "1"), leafNode("A", "2")}), at(4));
    EXPECT_EQ(changedAt(0), std::nullopt);
    EXPECT_EQ(changedAt(1), at(2));
    pane.show(treeNode("Section", {leafNode("B", "0"), leafNode("C", "0"), leafNode("A", "2")}),
              at(6));
    EXPECT_EQ(changedAt(2), at(2));
}

TEST_F(PaneAgesTest, ARowThatWasNotAskedForInBetweenHasNoAge) {
    tick(0, "1", "2");
    tick(2, "1", "3");
    EXPECT_EQ(changedAt(1), at(2));
    tick(4, "1", "9"); // the row is not requested
    tick(6, "1", "9");
    EXPECT_EQ(changedAt(1), std::nullopt);
}

TEST_F(PaneAgesTest, TheSameNodeAgainAndDataWithoutATimeMakeNoAge) {
    tick(0, "1", "2");
    const NodeRef now = treeNode("Section", {leafNode("A", "1"), leafNode("B", "3")});
    pane.show(now, at(2));
    pane.show(now, at(4));
    EXPECT_EQ(changedAt(1), at(2));
    pane.show(treeNode("Section", {leafNode("A", "1"), leafNode("B", "4")}));
    EXPECT_TRUE(pane.row(1).hasChanged);
    EXPECT_EQ(changedAt(1), std::nullopt);
}

TEST_F(PaneAgesTest, AfterAPaneWithoutANodeNoAgeIsLeft) {
    tick(0, "1", "2");
    tick(2, "1", "3");
    EXPECT_EQ(changedAt(1), at(2));
    pane.show(nullptr, at(4));
    tick(6, "1", "3");
    EXPECT_EQ(changedAt(1), std::nullopt);
}

} // namespace
} // namespace pallax
