#include "ui/contents/HitWalk.h"

#include "app/tree/PallaxModelNode.h"
#include "plist/PropertyList.h"
#include "tests/ui/pages/SampleTimeline.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using Direction = Travel::Direction;
using Place = std::vector<std::size_t>;

class HitWalkTest : public testing::Test {
protected:
    static NodeRef tree(const PropertyList& display) {
        PathDictionary paths;
        return PallaxModelNode::makeTreeFromObject(display, paths);
    }

    NodeRef root = tree(Dictionary{{"Cell", Dictionary{{"RSRP", "-94 dBm"}, {"State", "idle"}}},
                                   {"RSRP", "-90 dBm"}});
    Moment moment;
    bool mayGoOn = true;
    bool isPageOpen = false;
    std::size_t conditions = 0;
    Place cursor{0};
    std::vector<std::uint64_t> went;
    const EntryPartAt partAt = [](const std::string& /*path*/) { return EntryPart::None; };
    TextFinder finder{{.root = [this] { return root; },
                       .partAt = partAt,
                       .moment = [this] { return moment; },
                       .mayGoOn = [this] { return mayGoOn; }}};
    HitWalk walk{{.finder = finder,
                  .conditions = [this] { return conditions; },
                  .isPageOpen = [this] { return isPageOpen; },
                  .cursorPlace = [this] { return cursor; },
                  .goToPlace = [this](const Place& place) { cursor = place; },
                  .goToPacket =
                      [this](std::uint64_t packet) {
                          went.push_back(packet);
                          moment.instant = packet;
                      }}};
};

TEST_F(HitWalkTest, GoesFromRowToRowAndRoundTheDisplay) {
    walk.begin("rsrp", SearchScope::Frame);
    EXPECT_EQ(walk.go(Direction::Forward), "rsrp: 1 of 2");
    EXPECT_EQ(cursor, (Place{0, 0})) << "the row of the cell's pane";
    EXPECT_EQ(walk.go(Direction::Forward), "rsrp: 2 of 2");
    EXPECT_EQ(cursor, (Place{1}));
    EXPECT_EQ(walk.go(Direction::Forward), "rsrp: 1 of 2") << "after the last comes the first";
    EXPECT_EQ(walk.go(Direction::Back), "rsrp: 2 of 2");
    EXPECT_EQ(walk.go(Direction::Back), "rsrp: 1 of 2");
    cursor = {0, 1};
    EXPECT_EQ(walk.go(Direction::Back), "rsrp: 1 of 2") << "from where the cursor is";
}

TEST_F(HitWalkTest, TheNextRowIsOneOfTheFrameThatIsShownThen) {
    walk.begin("rsrp", SearchScope::Frame);
    root = tree(Dictionary{{"Operator", "Example"}});
    EXPECT_EQ(walk.go(Direction::Forward), "Nothing in this frame contains rsrp.");
    EXPECT_EQ(cursor, (Place{0}));
}

TEST_F(HitWalkTest, SaysThatThereAreMoreRowsThanItCounts) {
    Dictionary many;
    for (std::size_t row = 0; row <= TextFinder::kMostHits; ++row) {
        many.set("Row " + std::to_string(row), "x");
    }
    root = tree(many);
    walk.begin("row", SearchScope::Frame);
    cursor = {TextFinder::kMostHits - 1};
    EXPECT_EQ(walk.go(Direction::Forward), "row: 1 of 1000 (there are more)");
}

TEST_F(HitWalkTest, BelowAPageThereAreNoRowsToGoTo) {
    walk.begin("rsrp", SearchScope::Frame);
    isPageOpen = true;
    EXPECT_EQ(walk.go(Direction::Forward), "The hits are rows of panes: close the page first.");
    EXPECT_EQ(cursor, (Place{0}));
}

TEST_F(HitWalkTest, GoesFromInstantToInstantAlsoBelowAPage) {
    const terminal::SampleTimeline drive("utran");
    moment = {drive.timeline.get(), 0};
    isPageOpen = true;
    walk.begin("cell dch", SearchScope::Recording);
    EXPECT_EQ(walk.go(Direction::Forward), "");
    EXPECT_EQ(walk.go(Direction::Forward), "");
    ASSERT_EQ(went.size(), 2U);
    EXPECT_LT(went[0], went[1]);
    EXPECT_EQ(walk.go(Direction::Back), "");
    EXPECT_EQ(went.back(), went[0]);
    EXPECT_EQ(walk.go(Direction::Back), "There is no earlier hit.");
    moment.instant = drive.timeline->packets();
    EXPECT_EQ(walk.go(Direction::Forward), "There is no later hit.");
    EXPECT_EQ(went.size(), 3U);
}

TEST_F(HitWalkTest, ASearchThatIsStoppedGoesNowhere) {
    const terminal::SampleTimeline drive("utran");
    moment = {drive.timeline.get(), 0};
    walk.begin("cell dch", SearchScope::Recording);
    mayGoOn = false;
    EXPECT_EQ(walk.go(Direction::Forward), "The search was stopped.");
    EXPECT_TRUE(went.empty());
}

TEST_F(HitWalkTest, IsLatestUntilAConditionComesOrItIsForgotten) {
    EXPECT_FALSE(walk.isLatest()) << "nothing was searched";
    conditions = 1;
    walk.begin("rsrp", SearchScope::Frame);
    EXPECT_TRUE(walk.isLatest());
    conditions = 2;
    EXPECT_FALSE(walk.isLatest());
    walk.begin("rsrp", SearchScope::Frame);
    EXPECT_TRUE(walk.isLatest());
    walk.forget();
    EXPECT_FALSE(walk.isLatest());
}

} // namespace
} // namespace pallax
