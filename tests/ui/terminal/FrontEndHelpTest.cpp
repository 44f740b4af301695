#include "tests/ui/terminal/StageFixture.h"
#include "ui/pages/Overlays.h"

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
    EXPECT_EQ(stage.screen(80, 42), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────────────────────────────────────────────────────
▌Version                                                                     1
 E-ARFCN      ┌ Keys ────────────────────────────────────────────┐        1850
 Physical Cell│ Up Down  k j      one row up or down             │         274
 Measured RSRP│ PgUp PgDn         one page up or down            │  -94.75 dBm
 Average RSRP │ Home End  g G     first or last row              │  -95.00 dBm
 Measured RSRQ│ Enter Right l     open the row                   │    -9.50 dB
              │ Right Left  l h   scroll a long row              │
              │ Left h Backspace  back                           │
              │ Esc               clear the filter, or back      │
              │ /                 filter rows by name or value   │
              │ f                 find a text in all values      │
              │ t                 a list as a table or as rows   │
              │ < > r  x X        sort a table; hide columns     │
              │ o                 overview of the radio          │
              │ e ;               events; ask in SQL             │
              │ i Enter           all about the value            │
              │ v V               put it in the graph; open it   │
              │ Space             hold time; play on from there  │
              │ , .               one tick back or forward       │
              │ [ ]               to the event before or after   │
              │ { }               one minute back or forward     │
              │ ^ $               to the start; present or end   │
              │ :                 go to a time or a condition    │
              │ n N               next or previous place found   │
              │ m d               mark; changes since the mark   │
              │ ( )               play slower or faster          │
              │ s                 save a snapshot                │
              │ y                 copy the value                 │
              │ x                 safe: hide identities, or back │
              │ R                 reconnect, drop old values     │
              │ Click, wheel      open; scroll; drag time bar    │
              │ Ctrl-L            redraw the screen              │
              │ Ctrl-Z            suspend; fg resumes            │
              │ ?                 all keys                       │
              │ q                 back; at the first pane, quit  │
              │ Ctrl-C            quit                           │
              └──────────────────────────────────────────────────┘

 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    EXPECT_EQ(stage.screen(40, 12), R"(
 P┌ Keys ───────────────────────────┐
 ─│ Up Down  k j                    │──
▌V│  one row up or down             │1
 E│ PgUp PgDn                       │0
 P│  one page up or down            │4
 M│ Home End  g G                   │m
 A│  first or last row              │m
 M│ Enter Right l                   │B
  │  open the row                   │
  │ Right Left  l h                 │
 ─│  scroll a long row              │──
 U└────────────────────────── ↓ 58 ─┘lp
)");
    EXPECT_EQ(stage.screen(20, 5), R"(
┌ Keys ────────────┐
│ Up Down  k j     │
│  one row up or   │
│  down            │
└─────────── ↓ 97 ─┘
)");
}

TEST_F(FrontEndHelpTest, TheSameKeyAgainListsAllKeys) {
    stage.type("?");
    EXPECT_EQ(stage.screen(80, 42).find("Tab"), std::string::npos);
    stage.type("?");
    const std::string all = stage.screen();
    EXPECT_NE(all.find("Tab               next field on the save screen"), std::string::npos);
    EXPECT_NE(all.find("?                 this help"), std::string::npos);
    stage.type("?");
    EXPECT_FALSE(isOpen());
}

TEST_F(FrontEndHelpTest, OverTheOverviewOnlyItsKeysAreListed) {
    stage.type("o?");
    const std::string screen = stage.screen(80, 24);
    EXPECT_NE(screen.find("o                 overview of the radio"), std::string::npos);
    for (const char* other : {"filter rows", "copy the value", "open the row  "}) {
        EXPECT_EQ(screen.find(other), std::string::npos) << other;
    }
}

TEST_F(FrontEndHelpTest, OnTheSaveScreensButtonsOnlyItsKeysAreListed) {
    stage.saveHistory = snapshotItems();
    stage.type("s");
    stage.press(Key::Tab); // leaves the field, in which it is typed
    stage.type("?");
    const std::string screen = stage.screen(80, 24);
    EXPECT_NE(screen.find("Tab               next field on the save screen"), std::string::npos);
    EXPECT_EQ(screen.find("filter rows"), std::string::npos);
    stage.press(Key::Escape);
    EXPECT_FALSE(isOpen());
    EXPECT_NE(stage.saveScreen(), nullptr);
}

TEST_F(FrontEndHelpTest, TheArrowsScrollItWhereItDoesNotFit) {
    stage.type("?");
    stage.frontEnd.resize(20, 5);
    (void)stage.frontEnd.draw();
    stage.press(Key::Down);
    EXPECT_EQ(stage.line(1), "│  one row up or   │");
    stage.press(Key::Down, 120);
    EXPECT_EQ(stage.line(3), "│  quit            │");
    stage.press(Key::Up);
    EXPECT_EQ(stage.line(3), "│ Ctrl-C           │");
    stage.press(Key::Up, 120);
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
    stage.frontEnd.resize(80, 42);
    const std::string whole = stage.screen();
    stage.press(Key::End);
    EXPECT_EQ(stage.screen(), whole);
}

TEST_F(FrontEndHelpTest, ScrolledToItsEndItFillsAScreenThatGrows) {
    stage.type("?");
    const std::string fromTheFirstLine = stage.screen(80, 42);
    stage.frontEnd.resize(20, 5);
    (void)draw();
    stage.press(Key::Down, 120);
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
    EXPECT_EQ(stage.screen(80, 42), fromTheFirstLine);
}

TEST_F(FrontEndHelpTest, TheArrowsDoNothingWhereItFits) {
    stage.type("?");
    const std::string before = stage.screen(80, 42);
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
    stage.type("???");
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
         {"Up",  "Down", "PgUp", "PgDn", "Home",      "End",  "Enter",  "Right", "Left",
          "Esc", "h",    "j",    "k",    "Backspace", "l",    "g",      "G",     "/",
          "o",   "s",    "y",    "R",    "?",         "q",    "Ctrl-L", "e",     ";",
          "t",   "<",    ">",    "r",    "x",         "X",    "Ctrl-Z", "i",     "v",
          "V",   "+",    "-",    "Tab",  ":",         "Space"}) {
        EXPECT_NE(std::find(names.begin(), names.end(), key), names.end()) << key;
    }
}

/// Whether a character does something on the second row of a pane: the one that these keys open.
bool doesSomething(char character, const std::vector<Key>& open) {
    Travel travel{{.timeline = [] { return nullptr; },
                   .present = [] { return 0; },
                   .now = [] { return Time(); },
                   .steadyNow = [] { return std::chrono::steady_clock::time_point(); },
                   .zone = [](Time) { return std::chrono::seconds(0); }}};
    TerminalStage fresh(kUtf8Marks, &travel);
    fresh.frontEnd.showListsAsTables(true);
    fresh.tick(display());
    for (const Key key : open) {
        fresh.press(key);
    }
    (void)fresh.frontEnd.draw();
    const int displays = fresh.displays;
    fresh.type(std::string(1, character));
    return fresh.displays != displays || fresh.startsAfresh > 0;
}

TEST_F(FrontEndHelpTest, EveryCharacterThatDoesSomethingIsNamed) {
    const std::vector<std::string> names = namedKeys();
    for (char character = '!'; character < 0x7F; ++character) {
        const bool didSomething =
            doesSomething(character, {Key::Enter, Key::Down}) ||
            doesSomething(character, {Key::Down, Key::Enter, Key::Down}); // a table
        const bool isNamed =
            std::find(names.begin(), names.end(), std::string(1, character)) != names.end();
        const bool needsCurve = character == '+' || character == '-';
        EXPECT_EQ(didSomething || needsCurve, isNamed) << character;
    }
}

} // namespace
} // namespace pallax::terminal
