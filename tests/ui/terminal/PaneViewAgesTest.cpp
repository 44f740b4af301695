#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

namespace pallax::terminal {
namespace {

using namespace std::chrono_literals;

/// What the panes say about values that have not come.
class PaneViewAgesTest : public StageFixture {
protected:
    PaneViewAgesTest() {
        stage.showAges();
        stage.tick(display());
    }
};

TEST_F(PaneViewAgesTest, AnOverdueValueIsDimAndTellsItsAge) {
    stage.overdue = {{"/Serving Cell Measurements", 14s},
                     {"/Serving Cell Measurements/E-ARFCN", 200s},
                     {"/Serving Cell Measurements/Measured RSRP", 14s},
                     {"/Measured Neighbor Cells", 7200s}};
    EXPECT_EQ(stage.screen(80, 9), R"(
 Pallax
 ──────────────────────────────────────────────────────────────────────────────
▌Serving Cell Measurements                                              14 s   ›
 Measured Neighbor Cells                                                2 h  3 ›
 Empty List                                                                    ›
 SIM Info                                                                      ›
 Operator                                                              Example
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    EXPECT_EQ(styleAt(1, 2), (Style{.dim = true, .accent = true}));
    EXPECT_EQ(styleAt(1, 3), Style{.dim = true});
    EXPECT_EQ(styleAt(1, 4), Style{.bold = true});
    stage.press(Key::Enter);
    EXPECT_EQ(stage.screen(80, 10), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────────────────────────────────────────────────────
▌Version                                                                     1
 E-ARFCN                                                           3 min  1850
 Physical Cell ID                                                          274
 Measured RSRP                                                14 s  -94.75 dBm
 Average RSRP                                                       -95.00 dBm
 Measured RSRQ                                                        -9.50 dB
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    EXPECT_EQ(styleAt(1, 5), Style{.bold = true}) << "the name is as current as ever";
    EXPECT_EQ(styleAt(68, 5), Style{.dim = true});
    EXPECT_EQ(styleAt(62, 5), Style{.dim = true}) << "the age";
    EXPECT_EQ(styleAt(68, 6), Style{});
}

TEST_F(PaneViewAgesTest, WithoutRoomForTheAgeAMarkTellsIt) {
    stage.overdue = {{"/Serving Cell Measurements", 14s},
                     {"/Measured Neighbor Cells", 14s},
                     {"/Serving Cell Measurements/Measured RSRP", 14s}};
    EXPECT_EQ(stage.screen(30, 6), R"(
 Pallax
 ────────────────────────────
▌Serving Cell Measurements  o›
 Measured Neighbor Cells   3o›
 ────────────────────── ↓ 3 ─
 …ated 2023-11-14 at 22:13:20
)");
    stage.press(Key::Enter);
    stage.frontEnd.resize(33, 10);
    EXPECT_EQ(stage.line(5), " Measured RSRP       -94.75 dBm o");
    stage.frontEnd.resize(36, 10);
    EXPECT_EQ(stage.line(5), " Measured RSRP    14 s  -94.75 dBm");
}

TEST_F(PaneViewAgesTest, AnEmptyPaneSaysWhy) {
    stage.press(Key::Down, 2);
    stage.press(Key::Enter);
    EXPECT_EQ(stage.screen(40, 6), R"(
 Pallax › Empty List
 ──────────────────────────────────────
 Never reported.

 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
    EXPECT_EQ(styleAt(1, 2), Style{.dim = true});
    stage.overdue = {{"/Empty List", 14s}};
    EXPECT_EQ(stage.line(2), " Reported empty 14 s ago.");
}

TEST_F(PaneViewAgesTest, ValuesThatAreGoneAreNamedAboveTheRowsUntilTheNextTick) {
    stage.press(Key::Enter);
    Dictionary fewer{{"Version", "1"}, {"Physical Cell ID", "274"}, {"Average RSRP", "-95 dBm"}};
    stage.tick(Dictionary{{"Serving Cell Measurements", fewer}});
    stage.frontEnd.resize(80, 8);
    EXPECT_EQ(stage.line(1),
              " gone: E-ARFCN, Measured RSRP, Measured RSRQ ──────────────────────────────────");
    stage.frontEnd.resize(30, 8);
    EXPECT_EQ(stage.line(1), " gone: E-ARFCN, Measured RS…─");
    stage.frontEnd.setOldValues("22:13:30");
    EXPECT_EQ(stage.line(1), " old values: R ──────────────");
    stage.frontEnd.setOldValues("");
    stage.tick(Dictionary{{"Serving Cell Measurements", fewer}});
    EXPECT_EQ(stage.line(1), " ────────────────────────────");
}

} // namespace
} // namespace pallax::terminal
