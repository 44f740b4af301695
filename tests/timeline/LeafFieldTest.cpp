#include "timeline/LeafField.h"

#include "app/tree/PallaxModelNode.h"
#include "tests/timeline/TimelineFixture.h"

#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>

namespace pallax {
namespace {

const std::string kNeighbours = "/Neighbor Cells List/";

std::string textOf(const PallaxModelNode& leaf) {
    return leaf.value()->string().value_or(leaf.value()->description());
}

class LeafFieldOf : public testing::TestWithParam<const char*> {};

/// Compares every leaf of the display at several instants of a drive.
TEST_P(LeafFieldOf, EachLeafOfADriveIsAFieldWithTheShownValue) {
    TimelineFixture fixture(GetParam());
    fixture.drive(7, std::chrono::seconds(60));
    const auto timeline = fixture.indexed();
    std::size_t leaves = 0;
    std::set<std::string> fields;
    for (const std::uint64_t instant :
         {std::uint64_t{1}, timeline->packets() / 3, timeline->packets()}) {
        const CurrentValues values = timeline->valuesAt(instant);
        PathDictionary paths;
        const NodeRef root =
            PallaxModelNode::makeTreeFromObject(timeline->displayAt(instant), paths);
        ASSERT_NE(root, nullptr);
        for (const auto& [path, node] : paths) {
            if (node->childNodes() != nullptr || textOf(*node).empty()) {
                continue; // a row without a value yet
            }
            ++leaves;
            const auto leaf = leafAt(values, path);
            ASSERT_TRUE(leaf) << path << " = " << textOf(*node);
            const auto found = valueOf(values, *leaf);
            ASSERT_TRUE(found) << path << " = " << leaf->field << " of " << leaf->entry;
            if (!found->value.shown.string()) {
                EXPECT_EQ(textOf(*node), "(unknown)") << path; // data, which a row does not show
            } else {
                EXPECT_EQ(found->value.text(), textOf(*node)) << path;
            }
            fields.insert(leaf->field);
        }
    }
    EXPECT_GT(leaves, 60U);
    EXPECT_GE(fields.size(), 20U);
}

INSTANTIATE_TEST_SUITE_P(EachTechnology, LeafFieldOf, testing::ValuesIn(technologyNames()));

TEST(LeafField, AnEntryIsKnownByItsIdentityWhereverItStands) {
    TimelineFixture fixture("lte");
    fixture.drive(7, std::chrono::seconds(60));
    const auto timeline = fixture.indexed();
    const std::string level = "/Measured RSRP";
    std::uint64_t instant = timeline->packets();
    while (instant > 0 && !leafAt(timeline->valuesAt(instant), kNeighbours + "1" + level)) {
        instant -= 10;
    }
    const CurrentValues values = timeline->valuesAt(instant);
    const auto second = leafAt(values, kNeighbours + "1" + level);
    ASSERT_TRUE(second);
    EXPECT_EQ(second->field, "lte.neighbor_cells_list.measured_rsrp");
    EXPECT_TRUE(second->entry.starts_with("Physical Cell ID ")) << second->entry;
    EXPECT_EQ(second->entry, leafAt(values, kNeighbours + "1/Physical Cell ID")->entry);
    EXPECT_NE(second->entry, leafAt(values, kNeighbours + "0" + level)->entry);
    EXPECT_EQ(values.entries().words(valueOf(values, *second)->entry), second->entry);
}

TEST(LeafField, APathWithoutAFieldHasNone) {
    TimelineFixture fixture("lte");
    fixture.drive(7, std::chrono::seconds(10));
    const auto timeline = fixture.indexed();
    const CurrentValues& values = timeline->latestValues();
    for (const char* path :
         {"", "/", "/Serving Cell Measurements", "/Serving Cell Measurements/Nothing",
          "/Neighbor Cells List/99/Measured RSRP", "/Neighbor Cells List/x/Measured RSRP",
          "/Serving Cell Measurements/Measured RSRP/0", "no slash"}) {
        EXPECT_FALSE(leafAt(values, path)) << path;
    }
    EXPECT_FALSE(valueOf(values, {"lte.nothing", "", ""}));
    EXPECT_FALSE(
        valueOf(values, {"lte.neighbor_cells_list.measured_rsrp", "Physical Cell ID 9999", ""}));
}

} // namespace
} // namespace pallax
