#include "tests/app/AppFixture.h"

#include <algorithm>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using namespace std::chrono_literals;

/// {"Cells": {"Serving": {"Power": power}}, "SIM": "in"}
PropertyList threeLevels(const char* power) {
    return Dictionary{{"Cells", Dictionary{{"Serving", Dictionary{{"Power", power}}}}},
                      {"SIM", "in"}};
}

class PallaxAppUpdateTest : public AppFixture {
protected:
    void SetUp() override {
        AppFixture::SetUp();
        launch();
    }
    /// Opens "Cells" and "Serving" above the root.
    void browseThreeLevels() {
        tick(threeLevels("1"));
        openRow("Cells");
        openRow("Serving");
        ASSERT_EQ(depth(), 3U);
        toolkit.take();
    }
    /// Loses the link, which then cannot be restored.
    void disconnect() {
        telephony.reachable = false;
        ports.endLocal();
        ASSERT_FALSE(appModel->isConnected());
    }
    static std::size_t count(const ScreenDiary& diary, const std::string& line) {
        return static_cast<std::size_t>(std::count(diary.begin(), diary.end(), line));
    }
};

TEST_F(PallaxAppUpdateTest, ATickWithNewDataReloadsTheRootPaneFromTheTopLevelNodes) {
    tick(threeLevels("1"));
    EXPECT_EQ(rowsOf(pane(0)), "Cells SIM=in");
    tick(Dictionary{{"SIM", "out"}});
    EXPECT_EQ(rowsOf(pane(0)), "SIM=out");
}

TEST_F(PallaxAppUpdateTest, EveryPaneIsReloadedFromTheBottomUpwards) {
    browseThreeLevels();
    tick(threeLevels("2"));
    const ScreenDiary diary = toolkit.take();
    const auto at = [&diary](const char* line) {
        return std::find(diary.begin(), diary.end(), line) - diary.begin();
    };
    EXPECT_LT(at("table 1 reloadData"), at("table 2 reloadData"));
    EXPECT_LT(at("table 2 reloadData"), at("table 3 reloadData"));
    EXPECT_LT(at("table 3 reloadData"), static_cast<std::ptrdiff_t>(diary.size()));
    EXPECT_EQ(rowsOf(pane(2)), "Power=2");
    EXPECT_TRUE(pane(2).pane().row(0).hasChanged);
    EXPECT_EQ(pane(2).pane().row(0).changedAt, clock.now());
    EXPECT_EQ(depth(), 3U);
}

TEST_F(PallaxAppUpdateTest, ABranchThatDisappearsPopsToThePaneBelowTheFirstVanishedOne) {
    browseThreeLevels();
    tick(Dictionary{{"SIM", "out"}});
    ASSERT_EQ(depth(), 1U);
    EXPECT_EQ(rowsOf(top()), "SIM=out");
    const ScreenDiary diary = toolkit.take();
    EXPECT_EQ(count(diary, "stack popTo 0 animated=true"), 1U);
    EXPECT_EQ(count(diary, "table 1 reloadData"), 1U);
    EXPECT_EQ(count(diary, "table 2 reloadData"), 0U) << "the update stops there";
    EXPECT_EQ(count(diary, "table 3 reloadData"), 0U);
}

TEST_F(PallaxAppUpdateTest, WhenOnlyTheTopPanesPathIsGoneThePaneBelowIsShown) {
    browseThreeLevels();
    tick(Dictionary{{"Cells", Dictionary{{"Detected", Dictionary()}}}});
    ASSERT_EQ(depth(), 2U);
    EXPECT_EQ(top().path(), "/Cells");
    EXPECT_EQ(rowsOf(top()), "Detected");
    EXPECT_EQ(count(toolkit.take(), "stack popTo 1 animated=true"), 1U);
    EXPECT_EQ(statusOf(top()), "Updated 2023-11-14 at 22:13:24");
}

TEST_F(PallaxAppUpdateTest, APathThatNowHoldsALeafStaysOpenWithoutRows) {
    browseThreeLevels();
    tick(Dictionary{{"Cells", Dictionary{{"Serving", "none"}}}});
    ASSERT_EQ(depth(), 3U);
    EXPECT_EQ(top().title(), "Serving");
    EXPECT_EQ(top().numberOfRows(), 0U);
}

TEST_F(PallaxAppUpdateTest, ThePanesKeepTheOldTreeUntilTheyAreReloaded) {
    browseThreeLevels();
    ports.deliver({1});
    queue.runReady();
    generator().display = threeLevels("2");
    appModel->refresh(); // the tree is dropped, but the update only posted
    EXPECT_EQ(rowsOf(top()), "Power=1");
    queue.runReady();
    EXPECT_EQ(rowsOf(top()), "Power=2");
}

TEST_F(PallaxAppUpdateTest, WhileConnectedTheStatusTellsWhenDataArrived) {
    tick(threeLevels("1"));
    EXPECT_EQ(app->updateMessage(), "Updated 2023-11-14 at 22:13:22");
    EXPECT_EQ(statusOf(top()), "Updated 2023-11-14 at 22:13:22");
}

TEST_F(PallaxAppUpdateTest, TheStatusIsInTheLocalTimeZone) {
    clock.setZone({std::chrono::hours(2), true});
    tick(threeLevels("1"));
    EXPECT_EQ(statusOf(top()), "Updated 2023-11-15 at 00:13:22");
}

TEST_F(PallaxAppUpdateTest, ATickWithoutNewDataLeavesTheStatus) {
    tick(threeLevels("1"));
    toolkit.take();
    advance(10s);
    EXPECT_EQ(statusOf(top()), "Updated 2023-11-14 at 22:13:22");
    EXPECT_EQ(toolkit.take(), ScreenDiary{});
}

TEST_F(PallaxAppUpdateTest, OnlyTheTopPanesStatusIsRefreshedOnATick) {
    browseThreeLevels();
    tick(threeLevels("2"));
    EXPECT_EQ(statusOf(pane(2)), "Updated 2023-11-14 at 22:13:24");
    EXPECT_EQ(statusOf(pane(1)), "Updated 2023-11-14 at 22:13:22");
    EXPECT_EQ(statusOf(pane(0)), "Updated 2023-11-14 at 22:13:22");
}

TEST_F(PallaxAppUpdateTest, APaneUncoveredByGoingBackShowsTheCurrentStatus) {
    browseThreeLevels();
    tick(threeLevels("2"));
    stack().popTo(1, true);
    EXPECT_EQ(statusOf(top()), "Updated 2023-11-14 at 22:13:24");
    disconnect();
    stack().popTo(0, true);
    EXPECT_EQ(statusOf(top()), "Connecting... (loading)");
}

TEST_F(PallaxAppUpdateTest, WhileDisconnectedTheTopPaneShowsConnectingWithDots) {
    browseThreeLevels();
    disconnect();
    clock.advance(1s);
    app->updateViewControllerFromModel();
    EXPECT_EQ(statusOf(pane(2)), "Connecting... (loading)");
    EXPECT_EQ(statusOf(pane(1)), "Updated 2023-11-14 at 22:13:22");
    EXPECT_EQ(app->updateMessage(), "Updated 2023-11-14 at 22:13:22") << "not touched";
}

TEST_F(PallaxAppUpdateTest, PanesAreReloadedAndPoppedWhileDisconnected) {
    browseThreeLevels();
    ports.deliver({1});
    queue.runReady();
    generator().display = Dictionary{{"SIM", "out"}};
    disconnect();
    appModel->refresh();
    queue.runReady();
    ASSERT_EQ(depth(), 1U);
    EXPECT_EQ(rowsOf(top()), "SIM=out");
    EXPECT_EQ(statusOf(top()), "Connecting... (loading)");
}

TEST_F(PallaxAppUpdateTest, UpdateStatusGivesAPaneTheMessageOrConnecting) {
    app->setUpdateMessage("a message");
    app->updateStatusForViewController(pane(0));
    EXPECT_EQ(statusOf(pane(0)), "a message");
    disconnect();
    app->updateStatusForViewController(pane(0));
    EXPECT_EQ(statusOf(pane(0)), "Connecting... (loading)");
}

TEST_F(PallaxAppUpdateTest, BetweenConnectingAndTheFirstDataThePaneSaysConnectingWithDots) {
    app->navigationControllerWillShow(stack(), top(), false);
    EXPECT_EQ(statusOf(top()), "Connecting...") << "connected: the message, without a spinner";
}

TEST_F(PallaxAppUpdateTest, ADisplayThatIsNullLeavesTheRootPaneEmpty) {
    ports.deliver({1});
    queue.runReady();
    advance(PallaxModel::kDisplayInterval);
    EXPECT_EQ(top().title(), "Pallax");
    EXPECT_EQ(top().numberOfRows(), 0U);
    EXPECT_EQ(statusOf(top()), "Updated 2023-11-14 at 22:13:22");
}

TEST_F(PallaxAppUpdateTest, AfterALostLinkTheMonitorIsTriedAgainAndThePanesGoOn) {
    browseThreeLevels();
    disconnect();
    telephony.reachable = true;
    advance(5s);
    ASSERT_TRUE(appModel->isConnected());
    tick(threeLevels("3"));
    EXPECT_EQ(rowsOf(top()), "Power=3");
    EXPECT_EQ(statusOf(top()), "Updated 2023-11-14 at 22:13:29");
}

} // namespace
} // namespace pallax
