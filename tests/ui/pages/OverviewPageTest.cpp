#include "tests/ui/pages/SampleOverview.h"
#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

namespace pallax::terminal {
namespace {

constexpr Time kNow{std::chrono::seconds(1700000000)};

class OverviewPageTest : public StageFixture {
protected:
    OverviewPageTest() {
        stage.tick(display());
        stage.overview.status.time = kNow;
        stage.overview.status.states = {{"RRC", "", "Idle", 0, {}, kNow}};
    }
    bool isOpen() { return stage.line(0).find("Pallax › Overview") != std::string::npos; }
    bool shows(const std::string& text) { return stage.screen().find(text) != std::string::npos; }
};

TEST_F(OverviewPageTest, OpensOverAnyPaneAndLeavesTheStackAlone) {
    stage.press(Key::Enter);
    stage.press(Key::Down);
    const std::string pane = stage.screen();
    stage.type("o");
    EXPECT_TRUE(isOpen());
    EXPECT_TRUE(shows("State       RRC Idle"));
    EXPECT_EQ(stage.depth(), 2U);
    stage.press(Key::Down);
    stage.press(Key::Enter);
    stage.type("y/G");
    EXPECT_TRUE(isOpen());
    EXPECT_TRUE(stage.copied.empty());
    EXPECT_EQ(stage.depth(), 2U);
    stage.type("o");
    EXPECT_EQ(stage.screen(), pane);
}

TEST_F(OverviewPageTest, OtherPagesOpenFromItAndEachIsOpenOnce) {
    stage.type("oeoe");
    EXPECT_TRUE(shows("Pallax › Events"));
    stage.type("q");
    EXPECT_TRUE(isOpen());
    stage.type(";");
    EXPECT_TRUE(shows("Pallax › Query"));
    stage.press(Key::Escape);
    EXPECT_TRUE(isOpen());
    stage.type("q");
    EXPECT_EQ(stage.line(0), " Pallax");
    EXPECT_EQ(stage.quits, 0);
}

TEST_F(OverviewPageTest, ARowThatIsFoundFromItIsShownInItsPane) {
    stage.type("of");
    EXPECT_TRUE(shows("Pallax › Find in this frame"));
    stage.type("average rsrp");
    stage.press(Key::Enter);
    EXPECT_TRUE(shows("▌Average RSRP")) << stage.screen();
    stage.type("of");
    stage.press(Key::Escape);
    EXPECT_TRUE(isOpen()) << "nothing was found";
}

TEST_F(OverviewPageTest, SavesThePresent) {
    stage.type("os");
    EXPECT_NE(stage.saveScreen(), nullptr);
    stage.press(Key::Escape);
    stage.queue.runReady();
    EXPECT_EQ(stage.saveScreen(), nullptr);
    EXPECT_TRUE(isOpen());
}

TEST_F(OverviewPageTest, TheKeysThatGoBackCloseIt) {
    for (const Key key : {Key::Escape, Key::Left, Key::Backspace}) {
        stage.type("o");
        ASSERT_TRUE(isOpen());
        stage.press(key);
        EXPECT_FALSE(isOpen());
    }
    stage.type("oh");
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(OverviewPageTest, QClosesItAndQuitsOnlyAtTheFirstPane) {
    stage.type("oq");
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(stage.quits, 0);
    stage.type("q");
    EXPECT_EQ(stage.quits, 1);
    stage.press(Key::Enter);
    ASSERT_EQ(stage.depth(), 2U);
    stage.type("oq");
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(stage.depth(), 2U);
    EXPECT_EQ(stage.quits, 1);
}

TEST_F(OverviewPageTest, ShowsTheNewValuesAtEachTickWhileThePanesGoOn) {
    stage.press(Key::Enter);
    stage.type("o");
    (void)draw();
    const int displays = stage.displays;
    stage.overview.status.states.front().text = "Connected";
    stage.tick(Dictionary{{"Another", "1"}}); // the pane below it vanishes
    EXPECT_GT(stage.displays, displays);
    EXPECT_TRUE(shows("RRC Connected"));
    EXPECT_TRUE(isOpen());
    EXPECT_EQ(stage.depth(), 1U);
    stage.type("o");
    EXPECT_TRUE(shows("Another"));
}

TEST_F(OverviewPageTest, HelpAndAlertsLieOverIt) {
    stage.type("o?");
    EXPECT_TRUE(shows("┌ Keys"));
    EXPECT_TRUE(shows("o                 overview of the radio"));
    stage.press(Key::Escape);
    EXPECT_TRUE(isOpen());
    EXPECT_FALSE(shows("┌ Keys"));
    stage.frontEnd.toolkit().showAlert({"File Error", "No space", "Close"});
    EXPECT_TRUE(shows("No space"));
    stage.press(Key::Escape);
    EXPECT_TRUE(isOpen());
}

TEST_F(OverviewPageTest, StartsAfreshWithTheSameKeyAsThePanes) {
    stage.type("oR");
    EXPECT_EQ(stage.startsAfresh, 1);
    EXPECT_TRUE(isOpen());
}

TEST_F(OverviewPageTest, ItsHintsCanBeClicked) {
    stage.frontEnd.resize(80, 24);
    stage.type("o");
    const std::string line = stage.line(23);
    EXPECT_TRUE(line.ends_with("o panes  ? help")) << line;
    stage.click(79 - 3, 23);
    EXPECT_TRUE(shows("┌ Keys"));
    stage.press(Key::Escape);
    stage.click(10, 5); // nothing is there
    EXPECT_TRUE(isOpen());
    stage.click(79 - 15, 23);
    EXPECT_FALSE(isOpen());
}

TEST_F(OverviewPageTest, ScrollsWhatDoesNotFit) {
    stage.overview = overviewOf("lte-drive");
    stage.frontEnd.resize(40, 8);
    stage.type("o");
    EXPECT_TRUE(stage.line(6).find("↓ ") != std::string::npos) << stage.line(6);
    const std::string second = stage.line(3);
    stage.press(Key::Down);
    EXPECT_EQ(stage.line(2), second);
    EXPECT_NE(stage.line(1).find("↑ 1 ─"), std::string::npos) << stage.line(1);
    stage.press(Key::End);
    EXPECT_EQ(stage.line(6).find("↓"), std::string::npos);
    stage.mouse(Key::WheelUp, 0, 0);
    EXPECT_NE(stage.line(6).find("↓ 3 ─"), std::string::npos) << stage.line(6);
    stage.type("g");
    EXPECT_EQ(stage.line(3), second);
    stage.type("oo");
    EXPECT_EQ(stage.line(3), second);
}

TEST_F(OverviewPageTest, ShowsStatusMessageAndNoteLikeAPane) {
    stage.frontEnd.setNote("a gap of 61 s");
    stage.zone = "+0100";
    stage.type("o");
    EXPECT_TRUE(shows(" Updated 2023-11-14 at 22:13:20 +0100  a gap of 61 s"));
    stage.frontEnd.setMessage("Saved a.pallax");
    EXPECT_TRUE(shows(" Saved a.pallax"));
}

TEST_F(OverviewPageTest, AQualityAndItsBarHaveATintUnlessTheLevelIsOverdue) {
    StatusValue level{"RSRP", "lte.serving_cell_measurements.measured_rsrp", "-92 dBm", -92, {},
                      kNow};
    level.grade = Grade::Fair;
    stage.overview.status.cells = {{"LTE", "", {}, {}, "", {}, {level}}};
    level.grade = Grade::Poor;
    stage.overview.status.neighbours = {{"LTE", "PCI 1", level}};
    stage.type("o");
    const Grid now = draw();
    EXPECT_EQ(styleOf(now, "-92 dBm  fair"), Style{});
    EXPECT_EQ(styleOf(now, "fair"), Style{.tint = Tint::Orange});
    EXPECT_EQ(styleOf(now, "▆▆"), Style{.tint = Tint::Orange});
    EXPECT_EQ(styleOf(now, "poor"), Style{.tint = Tint::Red});
    stage.overview.status.cells.front().levels.front().patience = std::chrono::seconds(1);
    stage.overview.status.time = kNow + std::chrono::seconds(2);
    const Grid later = draw();
    EXPECT_EQ(styleOf(later, "fair"), Style{.dim = true});
    EXPECT_EQ(styleOf(later, "▆▆"), Style{.dim = true});
    EXPECT_EQ(styleOf(later, "poor"), Style{.tint = Tint::Red});
}

TEST_F(OverviewPageTest, SaysSoIfNothingIsKnown) {
    stage.overview = {};
    stage.type("o");
    EXPECT_EQ(stage.screen(80, 8), R"(
 Pallax › Overview
 ──────────────────────────────────────────────────────────────────────────────
 Nothing is known about the radio.



 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                 o panes  ? help
)");
}

TEST_F(OverviewPageTest, CanBeOpenedBeforeThePanes) {
    stage.frontEnd.openOverview();
    EXPECT_TRUE(isOpen());
    stage.press(Key::Escape);
    EXPECT_FALSE(isOpen());
}

TEST_F(OverviewPageTest, TheCharactersOfAModemCannotCommandTheTerminal) {
    Status& status = stage.overview.status;
    status.network = StatusOperator{std::nullopt, "漢\x1b[2J\xff", "", NameSource::Network, false};
    status.contexts = {{"\u202Eims\n", "up"}};
    status.cells = {{"\x07", "\x1b", {{"PCI", "", "\x9b", 0, {}, kNow}}, {}, "", {}, {}}};
    status.neighbours = {{"LTE", "e\u0301\x1b", {"RSRP", "", "\x1b", 0, {}, kNow}}};
    stage.overview.events = {{EventKind::CellChange, kNow, 1, "\x1b→\x07", {}}};
    stage.type("o");
    for (int columns = 0; columns < 140; ++columns) {
        for (const int rows : {0, 1, 4, 5, 7, 24}) {
            stage.frontEnd.resize(columns, rows);
            ASSERT_EQ(faultOf(draw()), "") << columns << "x" << rows;
        }
    }
    stage.frontEnd.resize(80, 24);
    EXPECT_TRUE(shows("漢\\x1B[2J"));
    EXPECT_TRUE(shows("22:13:20  \\x1B→\\x07"));
}

} // namespace
} // namespace pallax::terminal
