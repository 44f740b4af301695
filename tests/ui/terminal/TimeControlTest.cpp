#include "tests/timeline/TimelineFixture.h"
#include "tests/ui/drawing/GridSupport.h"
#include "tests/ui/terminal/TerminalStage.h"
#include "ui/terminal/SplitScreen.h"

#include <gtest/gtest.h>

#include <chrono>
#include <string>

namespace pallax::terminal {
namespace {

using namespace std::chrono_literals;

/// A viewer of a drive of two minutes that has been played to its end.
class TimeControlTest : public testing::Test {
protected:
    TimeControlTest() : TimeControlTest(kUtf8Marks) {}
    explicit TimeControlTest(const Marks& marks) : stage(marks, &travel) {
        _fixture.drive(5, 120s);
        timeline = _fixture.indexed();
        present = timeline->packets();
        showPresent();
    }
    /// The panes get the display of the present.
    void showPresent() { stage.tick(timeline->displayAt(present)); }
    bool shows(const std::string& text) { return stage.screen().find(text) != std::string::npos; }
    void goTo(const std::string& place) {
        stage.type(":" + place);
        stage.press(Key::Enter);
    }

    TimelineFixture _fixture{"lte"};
    std::unique_ptr<Timeline> timeline;
    std::uint64_t present = 0;
    Time now = Simulation::kStart + 120s;
    std::chrono::steady_clock::time_point steady{};
    Travel travel{{[this] { return timeline.get(); }, [this] { return present; },
                   [this] { return now; }, [this] { return steady; },
                   [](Time) { return std::chrono::seconds(0); }}};
    TerminalStage stage;
};

class AsciiTimeControlTest : public TimeControlTest {
protected:
    AsciiTimeControlTest() : TimeControlTest(kAsciiMarks) {}
};

TEST_F(TimeControlTest, AHeldInstantOnAScreenOfEachSize) {
    goTo("+60s");
    stage.type("m");
    stage.press(Key::Down); // the message goes
    goTo("+90s");
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax                                                       held, 30 s behind
 ──────────────────────────────────────────────────────────────────────────────
 Serving Cell Info                                                             ›
▌Serving Cell Measurements                                                     ›
 Connected mode LTE Intra-frequency Measurement                                ›
 Measured Neighbor Cells                                                     1 ›
 Detected Cells                                                                ›
 Neighbor Measurements                                                         ›
 Neighbor Cells List                                                         1 ›
 Reselection Candidates                                                        ›
 Reselection Candidates List                                                 1 ›
 SIM Info                                                                      ›
 PDP Context Info                                                            2 ›









 ──────────────────────────────────────────────────────────────────────────────
 ▕──┴─┴─┴──┴◆┴──●┴─┴──▏ 22:14:50        , . step  Space play  $ present  ? help
)");
    EXPECT_EQ(stage.screen(40, 20), R"(
 Pallax               held, 30 s behind
 ──────────────────────────────────────
 Serving Cell Info                     ›
▌Serving Cell Measurements             ›
 Connected mode LTE Intra-frequency M… ›
 Measured Neighbor Cells             1 ›
 Detected Cells                        ›
 Neighbor Measurements                 ›
 Neighbor Cells List                 1 ›
 Reselection Candidates                ›
 Reselection Candidates List         1 ›
 SIM Info                              ›
 PDP Context Info                    2 ›





 ──────────────────────────────────────
 ▕─────◆─●──▏ 22:14:50           ? help
)");
    EXPECT_EQ(stage.screen(200, 8), R"(
 Pallax                                                                                                                                                                               held, 30 s behind
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Serving Cell Info                                                                                                                                                                                     ›
▌Serving Cell Measurements                                                                                                                                                                             ›
 Connected mode LTE Intra-frequency Measurement                                                                                                                                                        ›
 Measured Neighbor Cells                                                                                                                                                                             1 ›
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────── ↓ 7 ─
 ▕────┴────┴─────┴────────┴◆───┴───────●──┴───┴─────▏ 22:14:50                                                                              [ ] event  : go to  , . step  Space play  $ present  ? help
)");
    EXPECT_EQ(stage.screen(20, 5), R"(
 Pallax        held
 ──────────── ↑ 1 ─
▌Serving Cell Mea… ›
 ──────────── ↓ 9 ─
 ▕────◆●──▏ 22:14:50
)");
}

TEST_F(AsciiTimeControlTest, AHeldInstantInAscii) {
    goTo("+60s");
    stage.type("m");
    stage.press(Key::Down);
    goTo("+90s");
    EXPECT_EQ(stage.screen(80, 8), R"(
 Pallax                                                       held, 30 s behind
 ------------------------------------------------------------------------ ^ 1 -
>Serving Cell Measurements                                                     >
 Connected mode LTE Intra-frequency Measurement                                >
 Measured Neighbor Cells                                                     1 >
 Detected Cells                                                                >
 ------------------------------------------------------------------------ v 6 -
 [--'-'-'--'m'--o'-'--] 22:14:50        , . step  Space play  $ present  ? help
)");
    stage.type("d");
    EXPECT_EQ(stage.screen(80, 12), R"(
 Pallax > Changes from 22:14:20 to 22:14:50                   held, 30 s behind
 ------------------------------------------------------------------------------
 Serving Cell Measurements
   Measured RSRP  -77.75 dBm -> -81.00 dBm (-3.25 dB)
   Average RSRP   -78.25 dBm -> -81.00 dBm (-2.75 dB)
   Measured RSRQ  -5.75 dB -> -6.00 dB (-0.25 dB)
   Measured RSSI  -52.00 dBm -> -55.00 dBm (-3.00 dB)
   Srxlev         44 dBm -> 41 dBm (-3 dB)

 Connected mode LTE Intra-frequency Measurement
 ----------------------------------------------------------------------- v 28 -
 [--'-'-'--'m'--o'-'--] 22:14:50        , . step  Space play  $ present  ? help
)");
}

TEST_F(TimeControlTest, TheMarkHasATint) {
    goTo("+60s");
    stage.type("m");
    stage.press(Key::Down); // the message goes
    goTo("+90s");
    const Grid grid = stage.frontEnd.draw();
    EXPECT_EQ(styleOf(grid, "◆"), Style{.tint = Tint::Purple});
    EXPECT_EQ(styleOf(grid, "●"), Style{.accent = true});
}

TEST_F(TimeControlTest, TheChangesSinceTheMark) {
    stage.type("d");
    EXPECT_TRUE(shows("Mark an instant first, with the key m."));
    goTo("+60s");
    stage.type("m");
    EXPECT_TRUE(shows("Marked 22:14:20. d shows what differs."));
    stage.press(Key::Down);
    stage.type("d");
    EXPECT_TRUE(shows("Pallax › Changes from 22:14:20 to 22:14:20"));
    EXPECT_TRUE(shows("Nothing differs."));
    stage.type("..");
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Changes from 22:14:20 to 22:14:24                   held, 56 s behind
 ──────────────────────────────────────────────────────────────────────────────
 Serving Cell Measurements
   Measured RSRP  -77.75 dBm → -76.75 dBm (+1.00 dB)
   Average RSRP   -78.25 dBm → -76.75 dBm (+1.50 dB)
   Average RSRQ   -6.00 dB → -5.75 dB (+0.25 dB)
   Measured RSSI  -52.00 dBm → -51.00 dBm (+1.00 dB)
   Srxlev         44 dBm → 45 dBm (+1 dB)

 Neighbor Cells List
   Physical Cell ID 243
     Measured RSSI  -52.50 dBm → -53.00 dBm (-0.50 dB)
     Measured RSRP  -87.50 dBm → -88.50 dBm (-1.00 dB)
     Average RSRP   -87.50 dBm → -89.00 dBm (-1.50 dB)
     Measured RSRQ  -15.50 dB → -16.00 dB (-0.50 dB)
     Average RSRQ   -15.50 dB → -16.00 dB (-0.50 dB)
     Srxlev         34 dBm → 33 dBm (-1 dB)





 ──────────────────────────────────────────────────────────────────────────────
 ▕──┴─┴─┴──┴●┴──┴┴─┴──▏ 22:14:24        , . step  Space play  $ present  ? help
)");
    stage.type("d");
    EXPECT_FALSE(shows("Changes from"));
}

TEST_F(TimeControlTest, ThePresentGoesOnBelowAHeldInstant) {
    present = 1000;
    showPresent();
    stage.press(Key::Enter); // Serving Cell Info
    ASSERT_EQ(stage.depth(), 2U);
    stage.type(" ");
    const std::string held = stage.screen();
    EXPECT_TRUE(held.find("Pallax › Serving Cell Info") != std::string::npos);
    stage.tick(Dictionary{{"Another", "1"}}); // the live pane vanishes
    EXPECT_EQ(stage.depth(), 1U);
    EXPECT_EQ(stage.screen(), held);
    stage.press(Key::Left);
    EXPECT_TRUE(shows("▌Serving Cell Info"));
    stage.press(Key::Down);
    stage.press(Key::Enter);
    EXPECT_TRUE(shows("Pallax › Serving Cell Measurements"));
    EXPECT_TRUE(shows("Measured RSRP"));
    stage.type("$");
    EXPECT_TRUE(shows("Another"));
    EXPECT_FALSE(shows("held"));
}

TEST_F(TimeControlTest, APaneThatTheInstantDoesNotHaveKeepsItsName) {
    stage.tick(Dictionary{{"Later", Dictionary{{"A", "1"}}}});
    stage.press(Key::Enter);
    stage.type(" ");
    EXPECT_TRUE(shows("Pallax › Later"));
    EXPECT_FALSE(shows(" A "));
}

TEST_F(TimeControlTest, WhatDiffersFromTheTickBeforeIsMarked) {
    goTo("+60s");
    stage.press(Key::Down);
    stage.press(Key::Enter);
    stage.type(".");
    EXPECT_TRUE(shows("-80.00 dBm *\n Average RSRP"));
    EXPECT_TRUE(shows(" 1850\n Physical Cell ID"));
}

TEST_F(TimeControlTest, PlaysWhileTheScreenTurns) {
    goTo("+60s");
    EXPECT_FALSE(stage.frontEnd.isAnimated());
    stage.type(")");
    EXPECT_TRUE(shows("Playing speed 2x"));
    stage.type(" ");
    EXPECT_TRUE(stage.frontEnd.isAnimated());
    EXPECT_TRUE(shows("playing 2x, 60 s behind"));
    EXPECT_TRUE(shows("Space hold"));
    const int displays = stage.displays;
    steady += 500ms;
    stage.frontEnd.turn();
    EXPECT_EQ(stage.displays, displays);
    steady += 5s;
    stage.frontEnd.turn();
    EXPECT_GT(stage.displays, displays);
    EXPECT_TRUE(shows("22:14:30"));
    stage.type("(");
    EXPECT_TRUE(shows("Playing speed 1x"));
    stage.type(" ");
    EXPECT_FALSE(stage.frontEnd.isAnimated());
    EXPECT_TRUE(shows("held, "));
}

TEST_F(TimeControlTest, TheKeysOfTimeWorkOverPagesToo) {
    stage.type("o");
    stage.type("^");
    EXPECT_TRUE(shows("Pallax › Overview"));
    EXPECT_TRUE(shows("held, 2 min behind"));
    stage.type(":packet = 700");
    EXPECT_TRUE(shows(" : packet = 700"));
    stage.press(Key::Enter);
    EXPECT_EQ(travel.moment().instant, 700U);
    stage.type("n");
    EXPECT_TRUE(shows("packet = 700 does not become true after this."));
    stage.type("N");
    EXPECT_TRUE(shows("packet = 700 did not become true before this."));
    stage.type("o");
    EXPECT_FALSE(shows("Overview"));
}

TEST_F(TimeControlTest, TheTypedPlaceIsEditedAsAFilterIs) {
    stage.type(":abc");
    EXPECT_TRUE(shows(" : abc"));
    EXPECT_TRUE(shows("Enter go  Esc leave"));
    stage.press(Key::Escape);
    EXPECT_FALSE(shows(" : abc"));
    stage.type(":a");
    stage.press(Key::Backspace);
    EXPECT_TRUE(shows("Enter go  Esc leave"));
    stage.press(Key::Backspace);
    EXPECT_FALSE(shows("Enter go  Esc leave"));
    stage.type(":");
    stage.press(Key::Enter); // nowhere
    EXPECT_FALSE(travel.isAway());
    goTo("yesterday");
    EXPECT_TRUE(shows("no such column: yesterday")) << stage.screen();
    EXPECT_FALSE(travel.isAway());
}

TEST_F(TimeControlTest, SavingSavesThePresentAndSaysSo) {
    stage.type(" s");
    EXPECT_NE(stage.saveScreen(), nullptr);
    EXPECT_TRUE(shows("The present is saved, not the instant that is shown."));
}

TEST_F(TimeControlTest, AClickOnTheBarGoesThere) {
    stage.type(" ");
    stage.click(2, 23);
    EXPECT_EQ(travel.moment().instant, 0U);
    stage.click(21, 23);
    EXPECT_EQ(travel.moment().instant, timeline->packets());
    stage.click(11, 23);
    EXPECT_NEAR(travel.shareOf(travel.moment().instant), 0.5, 0.05);
}

TEST_F(TimeControlTest, DraggingOnTheBarMovesTheHeldInstantUntilTheButtonIsReleased) {
    stage.type(" ");
    stage.click(11, 23);
    stage.mouse(Key::Drag, 6, 23);
    EXPECT_NEAR(travel.shareOf(travel.moment().instant), 4.0 / 19.0, 0.01);
    EXPECT_TRUE(shows("22:13:45")) << stage.screen();
    stage.mouse(Key::Drag, 0, 5); // beyond the bar, in another row
    EXPECT_EQ(travel.moment().instant, 0U);
    stage.mouse(Key::Drag, 79, 0);
    EXPECT_EQ(travel.moment().instant, timeline->packets());
    stage.mouse(Key::Drag, 11, 23);
    const std::uint64_t reached = travel.moment().instant;
    stage.mouse(Key::Release, 11, 23);
    stage.mouse(Key::Drag, 2, 23);
    EXPECT_EQ(travel.moment().instant, reached);
}

TEST_F(TimeControlTest, DraggingOnTheBarOfTheSecondModemMovesItsInstant) {
    stage.type(" ");
    TerminalStage other;
    SplitScreen split({{"car1", other.frontEnd}, {"car2", stage.frontEnd}}, kUtf8Marks, [] {});
    split.resize(160, 25);
    (void)split.draw();
    constexpr int kLeft = 80; // of the second side
    split.handle({.key = Key::Click, .x = kLeft + 11, .y = 24});
    (void)split.draw();
    split.handle({.key = Key::Drag, .x = kLeft + 79, .y = 3});
    EXPECT_EQ(travel.moment().instant, timeline->packets());
    split.handle({.key = Key::Drag, .x = 5, .y = 24}); // over the first side
    EXPECT_EQ(travel.moment().instant, 0U);
}

TEST_F(TimeControlTest, DraggingThatDidNotBeginOnTheBarDoesNothing) {
    stage.type(" ");
    stage.type("y");
    const std::uint64_t held = travel.moment().instant;
    stage.mouse(Key::Release, 5, 5);
    stage.click(5, 15);
    stage.mouse(Key::Drag, 6, 23);
    EXPECT_EQ(travel.moment().instant, held);
    stage.click(11, 23);
    stage.type("$"); // a key ends it
    stage.mouse(Key::Drag, 6, 23);
    EXPECT_FALSE(travel.isAway());
}

TEST_F(TimeControlTest, ReleasingTheButtonLeavesAMessage) {
    stage.type("m");
    stage.mouse(Key::Release, 5, 5);
    EXPECT_TRUE(shows("d shows what differs.")) << stage.screen();
}

TEST_F(TimeControlTest, WithoutATimelineTheKeysSaySo) {
    timeline.reset();
    stage.type(" ");
    EXPECT_TRUE(shows("No packet has come yet."));
    stage.type("d");
    EXPECT_TRUE(shows("Mark an instant first, with the key m."));
    EXPECT_FALSE(shows("held"));
}

} // namespace
} // namespace pallax::terminal
