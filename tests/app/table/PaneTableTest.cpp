#include "app/table/PaneTable.h"

#include "plist/PropertyList.h"

#include <gtest/gtest.h>

#include <chrono>
#include <string>

namespace pallax {
namespace {

class PaneTableTest : public testing::Test {
protected:
    static NodeRef list(const char* rsrp) {
        PathDictionary paths;
        const NodeRef root = PallaxModelNode::makeTreeFromObject(
            Dictionary{{"Cells", Array{Dictionary{{"PCI", "1"}, {"RSRP", "-90 dBm"}},
                                       Dictionary{{"PCI", "2"}, {"RSRP", rsrp}}}}},
            paths);
        return paths.at("/Cells");
    }
    void refresh() { listed.refresh(table, pane, look); }

    ListLook look{
        .asTables = true,
        .partAt =
            [](const std::string& path) {
                return path == "/Cells/*/PCI" ? EntryPart::Cell : EntryPart::None;
            },
        .ageAt = [this](const std::string& path) -> std::optional<std::chrono::nanoseconds> {
            return path == "/Cells/1/RSRP" ? std::optional(age) : std::nullopt;
        }};
    std::chrono::nanoseconds age = std::chrono::seconds(9);
    PaneModel pane{list("-95 dBm"), "/Cells"};
    TableModel table;
    PaneTable listed;
};

TEST_F(PaneTableTest, IsTheListOfThePaneWithItsCursor) {
    ASSERT_TRUE(showsTable(pane));
    EXPECT_FALSE(showsTable(PaneModel(nullptr, "/")));
    pane.moveCursorTo(1);
    refresh();
    EXPECT_EQ(table.content().many, "cells");
    EXPECT_EQ(table.shownRows(), 2U);
    EXPECT_EQ(table.cursor(), 1U);
}

TEST_F(PaneTableTest, MarksWhatHasChangedWhileItIsFollowed) {
    refresh();
    pane.show(list("-96 dBm"));
    refresh();
    EXPECT_TRUE(table.hasChanged(1, 1));
    EXPECT_FALSE(table.hasChanged(0, 1));
    const auto version = table.version();
    refresh();
    EXPECT_EQ(table.version(), version) << "there is nothing new";
    listed.forget();
    pane.show(list("-97 dBm"));
    refresh();
    EXPECT_FALSE(table.hasChanged(1, 1)) << "it was not followed";
}

TEST_F(PaneTableTest, AgesGrowWhileTheyAreShown) {
    refresh();
    table.showAllColumns();
    EXPECT_EQ(table.content().rows[1].cells[2].text, "9 s");
    age = std::chrono::seconds(10);
    listed.refreshAges(table, pane, look);
    EXPECT_EQ(table.content().rows[1].cells[2].text, "10 s");
    EXPECT_EQ(table.content().rows[0].cells[2].text, "");
}

} // namespace
} // namespace pallax
