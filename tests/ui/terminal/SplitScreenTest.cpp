#include "ui/terminal/SplitScreen.h"

#include "tests/doubles/Property.h"
#include "tests/ui/drawing/GridSupport.h"
#include "tests/ui/terminal/StageData.h"
#include "tests/ui/terminal/TerminalStage.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {
namespace {

/// Several stages on one screen. The first shows an LTE modem, the others a GSM one.
class SplitScreenTest : public testing::Test {
protected:
    void open(std::size_t count, const Marks& marks = kUtf8Marks) {
        std::vector<SplitScreen::Modem> modems;
        for (std::size_t number = 1; number <= count; ++number) {
            auto stage = std::make_unique<TerminalStage>(marks);
            const std::string name = "car" + std::to_string(number);
            stage->frontEnd.setOrigin({number == 1 ? "Zorell_LTE" : "Zorell_GSM", name});
            stage->tick(number == 1 ? display() : gsm());
            stage->chooseModem = [this](std::size_t chosen) { split->choose(chosen); };
            modems.push_back({name, stage->frontEnd});
            stages.push_back(std::move(stage));
        }
        split = std::make_unique<SplitScreen>(std::move(modems), marks, [this] { ++displays; });
    }
    static PropertyList gsm() {
        return Dictionary{{"Serving PLMN", Dictionary{{"MCC", "262"}, {"MNC", "42"}}},
                          {"GSM Serving Cell", Dictionary{{"ARFCN", "59"}}},
                          {"Neighboring Cells", Array{Dictionary{{"ARFCN", "80"}}}}};
    }
    std::string screen(int columns, int rows) {
        split->resize(columns, rows);
        return "\n" + split->draw().text();
    }
    std::string line(int y) { return split->draw().lines().at(static_cast<std::size_t>(y)); }
    void type(const std::string& text) {
        for (const char character : text) {
            split->handle(typed(static_cast<char32_t>(character)));
        }
    }
    void press(Key key) { split->handle({.key = key}); }
    void nextModem() { split->handle(typed(controlKey('n'))); }
    void mouse(Key key, int x, int y) {
        (void)split->draw();
        split->handle({.key = key, .x = x, .y = y});
    }

    std::vector<std::unique_ptr<TerminalStage>> stages;
    std::unique_ptr<SplitScreen> split;
    int displays = 0;
};

TEST_F(SplitScreenTest, TwoModemsFitBesideEachOtherInto160Columns) {
    open(2);
    EXPECT_EQ(screen(160, 24), R"(
[1 car1]                                                                         2 car2                                                             Ctrl-N next
 Pallax                                                      Zorell_LTE · car1 │ Pallax                                                       Zorell_GSM · car2
 ───────────────────────────────────────────────────────────────────────────── │ ──────────────────────────────────────────────────────────────────────────────
▌Serving Cell Measurements                                                    ›│▌Serving PLMN                                                                  ›
 Measured Neighbor Cells                                                    3 ›│ GSM Serving Cell                                                              ›
 Empty List                                                                   ›│ Neighboring Cells                                                           1 ›
 SIM Info                                                                     ›│
 Operator                                                             Example  │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
                                                                               │
 ───────────────────────────────────────────────────────────────────────────── │ ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                       / filter  s Save  ? help │ Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
}

TEST_F(SplitScreenTest, AWiderScreenHasWiderSides) {
    open(2);
    EXPECT_EQ(screen(200, 60), R"(
[1 car1]                                                                                             2 car2                                                                                 Ctrl-N next
 Pallax                                                                          Zorell_LTE · car1 │ Pallax                                                                           Zorell_GSM · car2
 ───────────────────────────────────────────────────────────────────────────────────────────────── │ ──────────────────────────────────────────────────────────────────────────────────────────────────
▌Serving Cell Measurements                                                                        ›│▌Serving PLMN                                                                                      ›
 Measured Neighbor Cells                                                                        3 ›│ GSM Serving Cell                                                                                  ›
 Empty List                                                                                       ›│ Neighboring Cells                                                                               1 ›
 SIM Info                                                                                         ›│
 Operator                                                                                 Example  │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
                                                                                                   │
 ───────────────────────────────────────────────────────────────────────────────────────────────── │ ──────────────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                           / filter  s Save  ? help │ Updated 2023-11-14 at 22:13:20                                            / filter  s Save  ? help
)");
}

TEST_F(SplitScreenTest, ANarrowScreenShowsOneAtATime) {
    open(2);
    EXPECT_EQ(screen(80, 24), R"(
[1 car1] 2 car2                                                     Ctrl-N next
 Pallax                                                       Zorell_LTE · car1
 ──────────────────────────────────────────────────────────────────────────────
▌Serving Cell Measurements                                                     ›
 Measured Neighbor Cells                                                     3 ›
 Empty List                                                                    ›
 SIM Info                                                                      ›
 Operator                                                              Example














 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    type("2");
    EXPECT_EQ(screen(80, 12), R"(
 1 car1 [2 car2]                                                    Ctrl-N next
 Pallax                                                       Zorell_GSM · car2
 ──────────────────────────────────────────────────────────────────────────────
▌Serving PLMN                                                                  ›
 GSM Serving Cell                                                              ›
 Neighboring Cells                                                           1 ›




 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
}

TEST_F(SplitScreenTest, OneModemHasTheWholeScreenToItself) {
    open(1);
    stages.front()->chooseModem = [](std::size_t) {};
    split->resize(200, 12);
    const std::string whole = "\n" + split->draw().text();
    EXPECT_EQ(whole, stages.front()->screen(200, 12));
    nextModem();
    type("2");
    EXPECT_EQ("\n" + split->draw().text(), whole);
}

TEST_F(SplitScreenTest, InAsciiItHasAsciiLines) {
    open(2, kAsciiMarks);
    EXPECT_EQ(screen(160, 8), R"(
[1 car1]                                                                         2 car2                                                             Ctrl-N next
 Pallax                                                       Zorell_LTE, car1 | Pallax                                                        Zorell_GSM, car2
 ----------------------------------------------------------------------------- | ------------------------------------------------------------------------------
>Serving Cell Measurements                                                    >|>Serving PLMN                                                                  >
 Measured Neighbor Cells                                                    3 >| GSM Serving Cell                                                              >
 Empty List                                                                   >| Neighboring Cells                                                           1 >
 ----------------------------------------------------------------------- v 2 - | ------------------------------------------------------------------------------
 Updated 2023-11-14 at 22:13:20                       / filter  s Save  ? help | Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
}

TEST_F(SplitScreenTest, AsManyAreVisibleAsFitAmongThemTheOneWithTheKeyboard) {
    open(3);
    split->resize(160, 12);
    EXPECT_EQ(line(0).substr(0, 24), "[1 car1] 2 car2  3 car3 ");
    EXPECT_NE(line(1).find("car1"), std::string::npos);
    EXPECT_EQ(line(1).find("car3"), std::string::npos);
    type("3");
    EXPECT_EQ(line(1).find("car1"), std::string::npos);
    EXPECT_LT(line(1).find("car2"), line(1).find("car3"));
    type("2");
    EXPECT_NE(line(1).find("car3"), std::string::npos) << "what is visible stays";
    type("1");
    EXPECT_LT(line(1).find("car1"), line(1).find("car2"));
    split->resize(239, 12);
    EXPECT_LT(line(1).find("car2"), line(1).find("car3"));
    EXPECT_LT(line(1).find("car1"), line(1).find("car2"));
}

TEST_F(SplitScreenTest, OneColumnLessThanTwoNeedShowsOne) {
    open(2);
    split->resize(158, 12);
    EXPECT_EQ(line(1).find("car2"), std::string::npos);
    split->resize(159, 12);
    EXPECT_NE(line(1).find("car2"), std::string::npos);
}

TEST_F(SplitScreenTest, KeysGoToTheModemWithTheKeyboard) {
    open(2);
    split->resize(160, 12);
    press(Key::Enter);
    EXPECT_EQ(stages[0]->depth(), 2U);
    EXPECT_EQ(stages[1]->depth(), 1U);
    nextModem();
    EXPECT_NE(line(0).find("[2 car2]"), std::string::npos);
    press(Key::Down);
    EXPECT_EQ(stages[1]->cursorName(), "GSM Serving Cell");
    EXPECT_EQ(stages[0]->cursorName(), "Version");
    nextModem();
    EXPECT_NE(line(0).find("[1 car1]"), std::string::npos) << "the first follows the last";
}

TEST_F(SplitScreenTest, NumbersOfMissingModemsDoNothing) {
    open(2);
    type("39");
    EXPECT_NE(line(0).find("[1 car1]"), std::string::npos);
    split->choose(0);
    EXPECT_NE(line(0).find("[1 car1]"), std::string::npos);
}

TEST_F(SplitScreenTest, ANumberInALineThatIsTypedIsText) {
    open(2);
    for (const std::string& begin : {std::string("/"), std::string("f"), std::string(";")}) {
        type(begin + "2");
        EXPECT_NE(line(0).find("[1 car1]"), std::string::npos) << begin;
        press(Key::Escape);
        press(Key::Escape);
    }
    type("/2");
    EXPECT_EQ(stages[0]->pane().filter(), "2");
    nextModem();
    EXPECT_NE(line(0).find("[2 car2]"), std::string::npos) << "this key is free everywhere";
    nextModem();
    type("7");
    EXPECT_EQ(stages[0]->pane().filter(), "27") << "the line waits for its modem";
}

TEST_F(SplitScreenTest, NumbersSwitchOnPagesToo) {
    open(2);
    for (const char* page : {"o", "e"}) {
        type(page);
        type("2");
        EXPECT_NE(line(0).find("[2 car2]"), std::string::npos) << page;
        type("1");
        EXPECT_NE(line(0).find("[1 car1]"), std::string::npos) << page;
        press(Key::Escape);
    }
}

TEST_F(SplitScreenTest, OnlyTheSideWithTheKeyboardHasTheCursor) {
    open(2);
    split->resize(160, 12);
    nextModem();
    type("/x");
    const auto cursor = split->draw().cursor();
    ASSERT_TRUE(cursor);
    EXPECT_EQ(*cursor, (Position{84, 11})) << "after the typed line";
    nextModem();
    EXPECT_FALSE(split->draw().cursor());
}

TEST_F(SplitScreenTest, AClickMovesTheKeyboardAndReachesWhatIsUnderIt) {
    open(2);
    split->resize(160, 12);
    mouse(Key::Click, 90, 4);
    EXPECT_NE(line(0).find("[2 car2]"), std::string::npos);
    EXPECT_EQ(stages[1]->depth(), 2U) << "a row opens";
    mouse(Key::Click, 79, 5);
    EXPECT_NE(line(0).find("[2 car2]"), std::string::npos) << "the line between them";
    mouse(Key::Click, 2, 0);
    EXPECT_NE(line(0).find("[1 car1]"), std::string::npos);
    mouse(Key::Click, 82, 0);
    EXPECT_NE(line(0).find("[2 car2]"), std::string::npos);
    mouse(Key::Click, 150, 0);
    EXPECT_NE(line(0).find("[1 car1]"), std::string::npos) << "Ctrl-N next";
}

TEST_F(SplitScreenTest, TheWheelScrollsWhatIsUnderItAndLeavesTheKeyboard) {
    open(2);
    split->resize(160, 12);
    mouse(Key::WheelDown, 90, 4);
    EXPECT_EQ(stages[1]->cursorName(), "Neighboring Cells");
    EXPECT_EQ(stages[0]->cursorName(), "Serving Cell Measurements");
    EXPECT_NE(line(0).find("[1 car1]"), std::string::npos);
    mouse(Key::WheelDown, 90, 0);
    EXPECT_EQ(stages[0]->cursorName(), "Serving Cell Measurements");
}

TEST_F(SplitScreenTest, AnAlarmIsMarkedAlsoWhereItsModemIsNotVisible) {
    open(2);
    split->resize(80, 12);
    stages[1]->frontEnd.setAlarms({"weak"});
    EXPECT_EQ(line(0).substr(0, 19), "[1 car1] 2 car2 !  ");
    stages[1]->frontEnd.setAlarms({});
    EXPECT_EQ(line(0).substr(0, 19), "[1 car1] 2 car2    ");
}

TEST_F(SplitScreenTest, NamesThatDoNotFitAreLeftOutExceptTheCurrentOne) {
    open(9);
    split->resize(60, 12);
    EXPECT_EQ(line(0), "[1 car1] 2  3  4  5  6  7  8  9                 Ctrl-N next");
    type("9");
    EXPECT_EQ(line(0), " 1  2  3  4  5  6  7  8 [9 car9]                Ctrl-N next");
    split->resize(35, 12);
    EXPECT_EQ(line(0), " 1  2  3  4  5  6  7  8 [9 car9]");
}

TEST_F(SplitScreenTest, EveryExtentCanBeDrawn) {
    open(3);
    for (const int columns : {-1, 0, 1, 2, 20, 79, 80, 158, 159, 160, 161, 238, 239, 240, 400}) {
        for (const int rows : {-1, 0, 1, 2, 5, 24}) {
            split->resize(columns, rows);
            const Grid grid = split->draw();
            EXPECT_EQ(grid.columns(), std::max(columns, 0));
            EXPECT_EQ(grid.rows(), std::max(rows, 0));
            EXPECT_EQ(faultOf(grid), "") << columns << "x" << rows;
        }
    }
}

TEST_F(SplitScreenTest, AfterAnyEventsTheScreenIsWholeAndOneModemHasTheKeyboard) {
    namespace any = doubles::any;
    EXPECT_TRUE(doubles::holds([this] {
        constexpr int kEvents = 30;
        split.reset();
        stages.clear();
        const std::size_t count = 2 + any::index(4);
        open(count);
        for (int event = 0; event < kEvents; ++event) {
            switch (any::between(0, 4)) {
            case 0:
                split->resize(any::between(30, 330), any::between(0, 12));
                break;
            case 1:
                mouse(any::between(0, 1) == 0 ? Key::Click : Key::WheelDown, any::between(-1, 330),
                      any::between(-1, 12));
                break;
            case 2:
                press(any::between(0, 1) == 0 ? Key::Enter : Key::Escape);
                break;
            case 3:
                nextModem();
                break;
            default:
                type(std::string(1, any::elementOf(std::string_view("123456789oe/f;?sq"))));
            }
            const Grid grid = split->draw();
            RC_ASSERT(faultOf(grid) == "");
            const std::string list = grid.rows() > 0 ? grid.lines().front() : "[]";
            RC_ASSERT(std::count(list.begin(), list.end(), '[') == 1);
        }
    }));
}

TEST_F(SplitScreenTest, ItTurnsWhileAnyModemWaits) {
    open(2);
    EXPECT_FALSE(split->isAnimated());
    stages[1]->tick(PropertyList());
    EXPECT_TRUE(split->isAnimated());
    split->resize(160, 12);
    const std::string before = line(11);
    split->turn();
    EXPECT_NE(line(11), before);
}

TEST_F(SplitScreenTest, ChoosingAModemAsksForADrawing) {
    open(2);
    displays = 0;
    split->choose(2);
    EXPECT_GT(displays, 0);
}

} // namespace
} // namespace pallax::terminal
