#include "tests/ui/terminal/StageFixture.h"
#include "ui/drawing/Origin.h"
#include "ui/drawing/TextWidth.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <utility>

namespace pallax::terminal {
namespace {

/// The origin of the values in the title and the line below it.
class PaneViewOriginTest : public StageFixture {
protected:
    PaneViewOriginTest() { stage.tick(display()); }
    void setOrigin() { stage.frontEnd.setOrigin({"Zorell_LTE", "lte-drive.pcap"}); }
};

TEST_F(PaneViewOriginTest, TechnologyAndSourceStandBesideTheWayHere) {
    setOrigin();
    EXPECT_EQ(stage.screen(80, 8), R"(
 Pallax                                             Zorell_LTE · lte-drive.pcap
 ──────────────────────────────────────────────────────────────────────────────
▌Serving Cell Measurements                                                     ›
 Measured Neighbor Cells                                                     3 ›
 Empty List                                                                    ›
 SIM Info                                                                      ›
 ──────────────────────────────────────────────────────────────────────── ↓ 1 ─
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    EXPECT_EQ(styleAt(60, 0), Style{.dim = true});
    stage.press(Key::Enter);
    EXPECT_EQ(stage.line(0),
              " Pallax › Serving Cell Measurements                 Zorell_LTE · lte-drive.pcap");
}

TEST_F(PaneViewOriginTest, WhatDoesNotFitIsShortenedOrLeftOut) {
    setOrigin();
    const std::pair<int, const char*> atTheRoot[] = {
        {40, " Pallax     Zorell_LTE · lte-drive.pcap"},
        {37, " Pallax  Zorell_LTE · lte-drive.pcap"},
        {36, " Pallax  Zorell_LTE · …e-drive.pcap"},
        {29, " Pallax  Zorell_LTE · ….pcap"},
        {28, " Pallax          Zorell_LTE"},
        {20, " Pallax  Zorell_LTE"},
    };
    for (const auto& [columns, title] : atTheRoot) {
        stage.frontEnd.resize(columns, 8);
        EXPECT_EQ(stage.line(0), title) << columns;
    }
    stage.press(Key::Enter);
    const std::pair<int, const char*> inASection[] = {
        {80, " Pallax › Serving Cell Measurements                 Zorell_LTE · lte-drive.pcap"},
        {60, " Pallax › Serving Cell Measurements  Zorell_LTE · …ive.pcap"},
        {40, " Pallax › Serving Cell Measurements"},
    };
    for (const auto& [columns, title] : inASection) {
        stage.frontEnd.resize(columns, 8);
        EXPECT_EQ(stage.line(0), title) << columns;
    }
}

TEST_F(PaneViewOriginTest, AFiltersCountStandsBehindThem) {
    setOrigin();
    stage.type("/info");
    stage.frontEnd.resize(60, 8);
    EXPECT_EQ(stage.line(0), " Pallax                  Zorell_LTE · lte-drive.pcap 1 of 5");
}

TEST_F(PaneViewOriginTest, TheStateOfTheStreamStandsAtTheEdgeOfTheTitle) {
    setOrigin();
    stage.frontEnd.setStream("no data for 7 s");
    stage.frontEnd.resize(80, 8);
    EXPECT_EQ(stage.line(0),
              " Pallax                            Zorell_LTE · lte-drive.pcap  no data for 7 s");
    EXPECT_EQ(styleAt(64, 0), Style{.bold = true});
    EXPECT_EQ(styleAt(60, 0), Style{.dim = true});
    stage.press(Key::Enter);
    const std::pair<int, const char*> expected[] = {
        {70, " Pallax › Serving Cell Measurements       Zorell_LTE  no data for 7 s"},
        {60, " Pallax › Serving Cell Measurements         no data for 7 s"},
        {40, " … › Serving Cell Mea…  no data for 7 s"},
        {20, " …  no data for 7 s"},
    };
    for (const auto& [columns, title] : expected) {
        stage.frontEnd.resize(columns, 8);
        EXPECT_EQ(stage.line(0), title) << columns;
    }
    stage.type("o");
    stage.frontEnd.resize(40, 8);
    EXPECT_EQ(stage.line(0), " Pallax › Overview      no data for 7 s");
    stage.frontEnd.setStream("");
    EXPECT_EQ(stage.line(0), " Pallax › Overview  Zorell_LTE · ….pcap");
}

TEST_F(PaneViewOriginTest, AlarmsStandInTheTitleAsLongAsTheyHold) {
    setOrigin();
    stage.frontEnd.setAlarms({"weak signal", "漢字"});
    const std::pair<int, const char*> expected[] = {
        {80, " Pallax                        Zorell_LTE · lte-drive.pcap  ! weak signal, 漢字"},
        {40, " Pallax             ! weak signal, 漢字"},
        {36, " Pallax      Zorell_LTE  ! 2 alarms"},
        {20, " Pallax         ! 2"},
    };
    stage.frontEnd.resize(80, 8);
    for (const auto& [columns, title] : expected) {
        stage.frontEnd.resize(columns, 8);
        EXPECT_EQ(stage.line(0), title) << columns;
    }
    stage.frontEnd.setStream("no data for 7 s");
    stage.frontEnd.resize(60, 8);
    EXPECT_EQ(stage.line(0), " Pallax    Zorell_LTE  ! weak signal, 漢字  no data for 7 s");
    EXPECT_EQ(styleAt(23, 0), Style{.bold = true});
    stage.type("o");
    EXPECT_EQ(stage.line(0), " Pallax › Overview     ! weak signal, 漢字  no data for 7 s");
    stage.frontEnd.setStream("");
    stage.frontEnd.setAlarms({"weak signal"});
    stage.frontEnd.resize(30, 8);
    EXPECT_EQ(stage.line(0), " …x › Overview  ! weak signal");
    stage.frontEnd.setAlarms({});
    EXPECT_EQ(stage.line(0), " Pallax › Overview");
}

TEST_F(PaneViewOriginTest, AnAlarmTextTakesNoMoreThanItsRoomIfPossible) {
    EXPECT_EQ(alarmText({}, 80), "");
    EXPECT_EQ(alarmText({"weak"}, 6), "! weak");
    EXPECT_EQ(alarmText({"weak signal"}, 9), "! 1 alarm");
    EXPECT_EQ(alarmText({"weak signal", "x"}, 9), "! 2");
    EXPECT_EQ(alarmText({"weak signal"}, 0), "! 1");
}

TEST_F(PaneViewOriginTest, WhatIsNotKnownYetIsNotShown) {
    stage.frontEnd.setOrigin({"", "live modem"});
    stage.frontEnd.resize(40, 8);
    EXPECT_EQ(stage.line(0), " Pallax                      live modem");
    stage.frontEnd.setOrigin({"Zorell_LTE", ""});
    EXPECT_EQ(stage.line(0), " Pallax                      Zorell_LTE");
}

TEST_F(PaneViewOriginTest, TheTextNeverTakesMoreThanItsRoom) {
    const Origin origin{"Zorell_LTE", "漢字漢字漢字\x1b.pcap"};
    for (int columns = -3; columns < 50; ++columns) {
        const std::string text = originText(origin, kUtf8Marks, columns);
        EXPECT_LE(columnsOf(text), std::max(columns, 0)) << text;
    }
    EXPECT_EQ(originText(origin, kUtf8Marks, 26), "Zorell_LTE · …字\\x1B.pcap");
}

TEST_F(PaneViewOriginTest, OldValuesAreToldAboveTheRows) {
    setOrigin();
    stage.frontEnd.setOldValues("22:13:30");
    EXPECT_EQ(stage.screen(80, 8), R"(
 Pallax                                             Zorell_LTE · lte-drive.pcap
 values from before 22:13:30: press R to start afresh ─────────────────────────
▌Serving Cell Measurements                                                     ›
 Measured Neighbor Cells                                                     3 ›
 Empty List                                                                    ›
 SIM Info                                                                      ›
 ──────────────────────────────────────────────────────────────────────── ↓ 1 ─
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    EXPECT_EQ(styleAt(1, 1), Style{.bold = true});
    const std::pair<int, const char*> expected[] = {
        {56, " values from before 22:13:30: press R to start afresh ─"},
        {54, " values from before 22:13:30: press R to start afresh"},
        {53, " values from before 22:13:30: R renews ─────────────"},
        {39, " values from before 22:13:30: R renews"},
        {38, " old values: R ──────────────────────"},
        {20, " old values: R ────"},
    };
    for (const auto& [columns, line] : expected) {
        stage.frontEnd.resize(columns, 9);
        EXPECT_EQ(stage.line(1), line) << columns;
    }
    stage.frontEnd.resize(60, 6); // the hint at rows above the window remains
    stage.press(Key::End);
    EXPECT_EQ(stage.line(1), " values from before 22:13:30: press R to start afresh ↑ 3 ─");
    stage.frontEnd.resize(40, 6);
    EXPECT_EQ(stage.line(1), " old values: R ────────────────── ↑ 3 ─");
    stage.frontEnd.setOldValues("");
    EXPECT_EQ(stage.line(1), " ──────────────────────────────── ↑ 3 ─");
}

TEST_F(PaneViewOriginTest, RStartsAfreshAndSoDoesAClickOnTheOffer) {
    stage.type("R");
    EXPECT_EQ(stage.startsAfresh, 1);
    stage.click(3, 1);
    EXPECT_EQ(stage.startsAfresh, 1) << "the key has no effect there";
    stage.frontEnd.setOldValues("22:13:30");
    stage.click(3, 1);
    EXPECT_EQ(stage.startsAfresh, 2);
    stage.press(Key::Enter);
    stage.type("/R");
    EXPECT_EQ(stage.startsAfresh, 2) << "it is typed";
    stage.press(Key::Enter);
    stage.type("R");
    EXPECT_EQ(stage.startsAfresh, 3);
    stage.saveHistory = snapshotItems();
    stage.type("sR");
    EXPECT_EQ(stage.startsAfresh, 3) << "it is typed";
    stage.press(Key::Tab);
    stage.type("R");
    EXPECT_EQ(stage.startsAfresh, 3) << "not below the save screen";
}

TEST_F(PaneViewOriginTest, InAsciiTheMarksAreAscii) {
    TerminalStage ascii(kAsciiMarks);
    ascii.tick(display());
    ascii.frontEnd.setOrigin({"Zorell_LTE", "drive.pcap"});
    ascii.frontEnd.resize(40, 6);
    (void)ascii.screen();
    ascii.press(Key::Down, 2);
    EXPECT_EQ(ascii.screen(), R"(
 Pallax          Zorell_LTE, drive.pcap
 -------------------------------- ^ 1 -
 Measured Neighbor Cells             3 >
>Empty List                            >
 -------------------------------- v 2 -
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

} // namespace
} // namespace pallax::terminal
