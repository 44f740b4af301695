#include "tests/app/AppFixture.h"

#include <algorithm>
#include <optional>
#include <string>
#include <vector>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using namespace std::chrono_literals;

/// How the application reports the link and starts afresh.
class PallaxAppLinkTest : public AppFixture {
protected:
    using Reports = std::vector<std::string>;

    void SetUp() override {
        AppFixture::SetUp();
        makeApp(false);
    }
    void makeApp(bool startsAfreshByItself) {
        linkChanged = [this](const std::string& technology, const std::optional<Time>& from) {
            reports.push_back(technology + (from ? ", from " + dateText(dateOf(*from)) : ""));
        };
        startsAfresh = startsAfreshByItself;
        AppFixture::makeApp();
        launch();
    }
    void browse() {
        tick(Dictionary{{"Cells", Dictionary{{"Serving", Dictionary{{"Power", "1"}}}}}});
        openRow("Cells");
        openRow("Serving");
        ASSERT_EQ(depth(), 3U);
    }
    /// Since the diary was taken.
    std::ptrdiff_t modelsMade() {
        const ScreenDiary diary = toolkit.take();
        return std::count(diary.begin(), diary.end(), "make model");
    }
    void restartLink() {
        ports.endLocal();
        queue.runReady();
    }

    Reports reports;
};

TEST_F(PallaxAppLinkTest, TheTechnologyIsToldWhenItIsKnown) {
    EXPECT_EQ(reports, Reports{"Fake"});
    restartLink();
    EXPECT_EQ(reports, (Reports{"Fake", "Fake"})) << "no values were shown before";
}

TEST_F(PallaxAppLinkTest, ARestartedLinkLeavesValuesFromTheLastTickBehind) {
    tick(Dictionary{{"SIM", "1"}}); // 22:13:22
    advance(7s);
    reports.clear();
    restartLink();
    EXPECT_EQ(reports, Reports{"Fake, from 2023-11-14 22:13:22 +0000"});
    tick(Dictionary{});
    advance(4s);
    restartLink();
    EXPECT_EQ(reports.back(), "Fake, from 2023-11-14 22:13:22 +0000") << "their age is unchanged";
    EXPECT_EQ(depth(), 1U);
}

TEST_F(PallaxAppLinkTest, StartingAfreshMakesANewModelWithAnEmptyState) {
    browse();
    restartLink();
    reports.clear();
    toolkit.take();
    app->startAfresh();
    EXPECT_EQ(modelsMade(), 1);
    EXPECT_EQ(depth(), 1U);
    EXPECT_EQ(rowsOf(top()), "");
    EXPECT_EQ(top().title(), "Pallax");
    EXPECT_EQ(statusOf(top()), "Connecting (loading)");
    EXPECT_FALSE(appModel->isConnected()) << "the first screen is drawn first";
    EXPECT_EQ(FakeGenerator::living.size(), 0U);
    queue.runReady();
    EXPECT_TRUE(appModel->isConnected());
    EXPECT_EQ(reports, (Reports{"", "Fake"}));
    tick(Dictionary{{"SIM", "new"}});
    EXPECT_EQ(rowsOf(top()), "SIM=new");
    EXPECT_EQ(statusOf(top()), "Updated 2023-11-14 at 22:13:24");
}

TEST_F(PallaxAppLinkTest, StartingAfreshIsPossibleAtAnyMoment) {
    app->startAfresh(); // connected, without data
    app->startAfresh(); // not connected yet
    queue.runReady();
    EXPECT_TRUE(appModel->isConnected());
    const std::size_t connected = starts();
    telephony.reachable = false;
    restartLink();
    app->startAfresh(); // while the old model waits for its retry
    queue.runReady();
    EXPECT_EQ(starts(), connected + 2);
    advance(PallaxModel::kRetryDelay);
    EXPECT_EQ(starts(), connected + 3) << "only one model retries";
    telephony.reachable = true;
    advance(PallaxModel::kRetryDelay);
    EXPECT_TRUE(appModel->isConnected());
    tick(Dictionary{{"SIM", "1"}});
    EXPECT_EQ(rowsOf(top()), "SIM=1");

    app->applicationWillTerminate();
    app->startAfresh(); // nothing to start
    queue.runReady();
    EXPECT_EQ(app->navigationController()->screens().size(), 1U);
}

TEST_F(PallaxAppLinkTest, AnOpenSnapshotScreenKeepsWhatItHolds) {
    spoken = kHistoryTechnologies;
    reply = technology("History");
    makeApp(false);
    tick(Dictionary{{"SIM", "old"}});
    app->showSaveView();
    const auto screen = app->saveViewController();
    ASSERT_EQ(screen->numberOfRows(), 1U);
    app->startAfresh();
    queue.runReady();
    EXPECT_EQ(app->saveViewController(), screen);
    EXPECT_EQ(screen->numberOfRows(), 1U);
    screen->savePressed();
    queue.runReady();
    EXPECT_EQ(app->saveViewController(), nullptr);
    tick(Dictionary{{"SIM", "new"}});
    EXPECT_EQ(rowsOf(top()), "SIM=new");
}

TEST_F(PallaxAppLinkTest, TheSettingStartsAfreshWhereAReconnectWouldLeaveOldValues) {
    makeApp(true);
    restartLink();
    EXPECT_EQ(reports, (Reports{"Fake", "Fake", "Fake"})) << "no values were shown before";
    browse();
    reports.clear();
    toolkit.take();
    restartLink();
    EXPECT_EQ(modelsMade(), 1);
    EXPECT_TRUE(appModel->isConnected());
    EXPECT_EQ(reports, (Reports{"", "Fake"})) << "old values are not reported";
    EXPECT_EQ(depth(), 1U);
    tick(Dictionary{{"SIM", "new"}});
    EXPECT_EQ(rowsOf(top()), "SIM=new");
}

} // namespace
} // namespace pallax
