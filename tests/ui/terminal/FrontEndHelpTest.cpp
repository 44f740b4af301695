#include "tests/ui/terminal/StageFixture.h"
#include "ui/terminal/Overlays.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <sstream>
#include <string>

namespace pallax::terminal {
namespace {

class FrontEndHelpTest : public StageFixture {
protected:
    FrontEndHelpTest() {
        stage.tick(display());
        stage.press(Key::Enter);
    }
    bool isOpen() { return stage.screen(40, 12).find("┌ Keys") != std::string::npos; }
};

TEST_F(FrontEndHelpTest, TheHelpPageLiesOverThePane) {
    stage.type("?");
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Serv┌ Keys ───────────────────────────────────────────┐
 ─────────────│ Up Down  k j      one row up or down            │──────────────
▌Version      │ PgUp PgDn         one page up or down           │            1
 E-ARFCN      │ Home End  g G     first or last row             │         1850
 Physical Cell│ Enter Right l     open the row                  │          274
 Measured RSRP│ Right Left  l h   scroll a long row             │   -94.75 dBm
 Average RSRP │ Left h Backspace  back                          │   -95.00 dBm
 Measured RSRQ│ Esc               clear the filter, or back     │     -9.50 dB
              │ /                 filter rows by name or value  │
              │ o                 overview of the radio         │
              │ i Enter           all about the value           │
              │ v V               put it in the graph; open it  │
              │ + -  Left Right   zoom and read a curve         │
              │ s                 save a snapshot               │
              │ y                 copy the value                │
              │ R                 reconnect, drop old values    │
              │ Tab               next field on the save screen │
              │ Click, wheel      open the row; scroll          │
              │ Ctrl-L            redraw the screen             │
              │ Ctrl-Z            suspend; fg resumes           │
              │ ?                 this help                     │
              │ q                 back; at the first pane, quit │
 ─────────────│ Ctrl-C            quit                          │──────────────
 Updated 2023-└─────────────────────────────────────────────────┘s Save  ? help
)");
    EXPECT_EQ(stage.screen(40, 12), R"(
 Pa┌ Keys ──────────────────────────┐
 ──│ Up Down  k j                   │──
▌Ve│  one row up or down            │1
 E-│ PgUp PgDn                      │0
 Ph│  one page up or down           │4
 Me│ Home End  g G                  │m
 Av│  first or last row             │m
 Me│ Enter Right l                  │B
   │  open the row                  │
   │ Right Left  l h                │
 ──│  scroll a long row             │──
 Up└────────────────────────────────┘lp
)");
    EXPECT_EQ(stage.screen(20, 5), R"(
┌ Keys ────────────┐
│ Up Down  k j     │
│  one row up or   │
│  down            │
└──────────────────┘
)");
}

TEST_F(FrontEndHelpTest, TheArrowsScrollItWhereItDoesNotFit) {
    stage.type("?");
    stage.frontEnd.resize(20, 5);
    (void)stage.frontEnd.draw();
    stage.press(Key::Down);
    EXPECT_EQ(stage.line(1), "│  one row up or   │");
    stage.press(Key::Down, 80);
    EXPECT_EQ(stage.line(3), "│  quit            │");
    stage.press(Key::Up);
    EXPECT_EQ(stage.line(3), "│ Ctrl-C           │");
    stage.press(Key::Up, 80);
    EXPECT_EQ(stage.line(1), "│ Up Down  k j     │");
}

TEST_F(FrontEndHelpTest, PagesWheelAndLettersScrollItToo) {
    stage.type("?");
    stage.frontEnd.resize(20, 5);
    (void)stage.frontEnd.draw();
    stage.type("j");
    EXPECT_EQ(stage.line(1), "│  one row up or   │");
    stage.type("k");
    EXPECT_EQ(stage.line(1), "│ Up Down  k j     │");
    stage.press(Key::PageDown);
    EXPECT_EQ(stage.line(1), "│ PgUp PgDn        │");
    stage.press(Key::PageUp);
    EXPECT_EQ(stage.line(1), "│ Up Down  k j     │");
    stage.frontEnd.handle({Key::WheelDown});
    EXPECT_EQ(stage.line(1), "│ PgUp PgDn        │");
    stage.frontEnd.handle({Key::WheelUp});
    EXPECT_EQ(stage.line(1), "│ Up Down  k j     │");
}

TEST_F(FrontEndHelpTest, HomeAndEndScrollItToItsEndsAndLeaveItOpen) {
    stage.type("?");
    stage.frontEnd.resize(20, 5);
    (void)stage.frontEnd.draw();
    stage.press(Key::End);
    EXPECT_EQ(stage.line(3), "│  quit            │");
    stage.press(Key::Home);
    EXPECT_EQ(stage.line(1), "│ Up Down  k j     │");
    stage.type("G");
    EXPECT_EQ(stage.line(3), "│  quit            │");
    stage.type("g");
    EXPECT_EQ(stage.line(1), "│ Up Down  k j     │");
    stage.frontEnd.resize(80, 24);
    const std::string whole = stage.screen();
    stage.press(Key::End);
    EXPECT_EQ(stage.screen(), whole);
}

TEST_F(FrontEndHelpTest, ScrolledToItsEndItFillsAScreenThatGrows) {
    stage.type("?");
    const std::string fromTheFirstLine = stage.screen(80, 24);
    stage.frontEnd.resize(20, 5);
    (void)draw();
    stage.press(Key::Down, 80);
    EXPECT_EQ(stage.screen(20, 7), R"(
┌ Keys ────────────┐
│  back; at the    │
│  first pane,     │
│  quit            │
│ Ctrl-C           │
│  quit            │
└──────────────────┘
)");
    stage.press(Key::Up); // scrolls at once
    EXPECT_EQ(stage.line(1), "│ q                │");
    EXPECT_EQ(stage.screen(80, 24), fromTheFirstLine);
}

TEST_F(FrontEndHelpTest, TheArrowsDoNothingWhereItFits) {
    stage.type("?");
    const std::string before = stage.screen(80, 24);
    stage.press(Key::Down);
    EXPECT_EQ(stage.screen(), before);
    stage.press(Key::Up);
    EXPECT_EQ(stage.screen(), before);
}

TEST_F(FrontEndHelpTest, AnyOtherKeyClosesItAndDoesNothingElse) {
    stage.type("?");
    stage.type("q");
    EXPECT_FALSE(isOpen());
    stage.type("?");
    stage.press(Key::Escape);
    EXPECT_FALSE(isOpen());
    stage.type("??");
    EXPECT_FALSE(isOpen());
    stage.type("?");
    stage.click(3, 3);
    EXPECT_FALSE(isOpen());
    stage.type("?s");
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(stage.saveScreen(), nullptr);
    EXPECT_EQ(stage.depth(), 2U);
    EXPECT_EQ(stage.cursorName(), "Version");
}

TEST_F(FrontEndHelpTest, ControlLLeavesItOpen) {
    stage.type("?");
    stage.pressControl('l');
    EXPECT_TRUE(isOpen());
    EXPECT_EQ(stage.repaints, 1);
}

TEST_F(FrontEndHelpTest, ItOpensAtItsFirstLineAgain) {
    stage.frontEnd.resize(20, 5);
    stage.type("?");
    (void)stage.frontEnd.draw();
    stage.press(Key::Down, 3);
    stage.type("q?");
    EXPECT_EQ(stage.line(1), "│ Up Down  k j     │");
}

/// The words in the left column of the help page.
std::vector<std::string> namedKeys() {
    constexpr std::size_t kColumn = 18;
    std::vector<std::string> names;
    for (const std::string& line : helpLines(80)) {
        std::istringstream words{std::string(line.substr(0, kColumn))};
        for (std::string word; words >> word;) {
            names.push_back(word);
        }
    }
    return names;
}

TEST_F(FrontEndHelpTest, EveryKeyIsNamed) {
    const std::vector<std::string> names = namedKeys();
    for (const char* key :
         {"Up",   "Down",      "PgUp", "PgDn", "Home", "End",    "Enter",  "Right",
          "Left", "Backspace", "Esc",  "h",    "j",    "k",      "l",      "g",
          "G",    "/",         "o",    "i",    "v",    "V",      "+",      "-",
          "s",    "y",         "R",    "?",    "q",    "Ctrl-L", "Ctrl-Z", "Tab"}) {
        EXPECT_NE(std::find(names.begin(), names.end(), key), names.end()) << key;
    }
}

TEST_F(FrontEndHelpTest, EveryCharacterThatDoesSomethingIsNamed) {
    const std::vector<std::string> names = namedKeys();
    for (char character = ' '; character < 0x7F; ++character) {
        TerminalStage fresh;
        fresh.tick(display());
        fresh.press(Key::Enter);
        fresh.press(Key::Down);
        (void)fresh.frontEnd.draw();
        const int displays = fresh.displays;
        const std::string name(1, character);
        fresh.type(name);
        const bool didSomething = fresh.displays != displays || fresh.startsAfresh > 0;
        const bool isNamed = std::find(names.begin(), names.end(), name) != names.end();
        // 'l' would scroll or open, but has no effect on this row; the others are keys of pages.
        const bool hasNoEffect = std::string_view("l+-").find(character) != std::string_view::npos;
        EXPECT_EQ(didSomething || hasNoEffect, isNamed) << name;
    }
}

} // namespace
} // namespace pallax::terminal
