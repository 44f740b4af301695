#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

namespace pallax::terminal {
namespace {

class FrontEndBrowsingTest : public StageFixture {
protected:
    FrontEndBrowsingTest() { stage.tick(display()); }
    /// A pane of ten leaves, "Row 0" to "Row 9", on a screen with room for five.
    void openTenRows() {
        Dictionary rows;
        for (int row = 0; row < 10; ++row) {
            rows.set(Text("Row " + std::to_string(row)), std::to_string(row));
        }
        stage.tick(Dictionary{{"Ten", rows}});
        stage.press(Key::Enter);
        stage.frontEnd.resize(40, 9);
        (void)stage.frontEnd.draw();
        ASSERT_EQ(stage.cursorName(), "Row 0");
    }
    std::string cursorAfter(Key key) {
        stage.press(key);
        return stage.cursorName();
    }
    std::string cursorAfter(const char* character) {
        stage.type(character);
        return stage.cursorName();
    }
};

TEST_F(FrontEndBrowsingTest, WithoutAWindowNothingIsDrawnAndNoKeyIsTaken) {
    int calls = 0;
    FrontEnd alone({[&calls] { ++calls; }, [&calls] { ++calls; },
                    [&calls](const std::string&) { ++calls; }, [&calls] { ++calls; }},
                   kUtf8Marks);
    alone.handle({.key = Key::Character, .character = U'q'});
    alone.handle({.key = Key::Click});
    alone.handle({.key = Key::Character, .character = controlKey('l')});
    EXPECT_EQ(calls, 0);
    EXPECT_FALSE(alone.isAnimated());
    EXPECT_EQ(alone.draw().text(), std::string(24, '\n'));
}

TEST_F(FrontEndBrowsingTest, ArrowsAndJkMoveByOneRow) {
    openTenRows();
    EXPECT_EQ(cursorAfter(Key::Down), "Row 1");
    EXPECT_EQ(cursorAfter("j"), "Row 2");
    EXPECT_EQ(cursorAfter(Key::Up), "Row 1");
    EXPECT_EQ(cursorAfter("k"), "Row 0");
    EXPECT_EQ(cursorAfter(Key::Up), "Row 0");
}

TEST_F(FrontEndBrowsingTest, PgUpAndPgDnMoveByAPage) {
    openTenRows();
    EXPECT_EQ(cursorAfter(Key::PageDown), "Row 4");
    EXPECT_EQ(cursorAfter(Key::PageDown), "Row 8");
    EXPECT_EQ(cursorAfter(Key::PageDown), "Row 9");
    EXPECT_EQ(cursorAfter(Key::PageUp), "Row 5");
}

TEST_F(FrontEndBrowsingTest, HomeEndAndGMoveToTheEnds) {
    openTenRows();
    EXPECT_EQ(cursorAfter(Key::End), "Row 9");
    EXPECT_EQ(cursorAfter(Key::Home), "Row 0");
    EXPECT_EQ(cursorAfter("G"), "Row 9");
    EXPECT_EQ(cursorAfter("g"), "Row 0");
}

TEST_F(FrontEndBrowsingTest, EnterRightAndLOpenABranch) {
    for (const auto& open : {KeyEvent{.key = Key::Enter}, KeyEvent{.key = Key::Right},
                             KeyEvent{.key = Key::Character, .character = U'l'}}) {
        stage.frontEnd.handle(open);
        EXPECT_EQ(stage.depth(), 2U);
        EXPECT_EQ(stage.line(0), " Pallax › Serving Cell Measurements");
        stage.press(Key::Left);
    }
}

TEST_F(FrontEndBrowsingTest, LeftHBackspaceEscAndQGoBack) {
    for (const auto& back :
         {KeyEvent{.key = Key::Left}, KeyEvent{.key = Key::Backspace}, KeyEvent{.key = Key::Escape},
          KeyEvent{.key = Key::Character, .character = U'h'},
          KeyEvent{.key = Key::Character, .character = U'q'}}) {
        stage.press(Key::Enter);
        ASSERT_EQ(stage.depth(), 2U);
        stage.frontEnd.handle(back);
        EXPECT_EQ(stage.depth(), 1U);
    }
    EXPECT_EQ(stage.quits, 0);
}

TEST_F(FrontEndBrowsingTest, AtTheFirstPaneOnlyQQuits) {
    for (const Key key : {Key::Left, Key::Backspace, Key::Escape}) {
        stage.press(key);
    }
    stage.type("h");
    EXPECT_EQ(stage.quits, 0);
    stage.type("q");
    EXPECT_EQ(stage.quits, 1);
}

TEST_F(FrontEndBrowsingTest, OpeningALeafDoesNothing) {
    stage.press(Key::End);
    ASSERT_EQ(stage.cursorName(), "Operator");
    stage.press(Key::Enter);
    stage.press(Key::Right);
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndBrowsingTest, OnAPaneWithoutRowsKeysHaveNoEffect) {
    stage.press(Key::Down, 2);
    stage.press(Key::Enter); // the empty list
    ASSERT_EQ(stage.depth(), 2U);
    ASSERT_EQ(stage.cursorName(), "(none)");
    for (const Key key : {Key::Up, Key::Down, Key::PageUp, Key::PageDown, Key::Home, Key::End,
                          Key::Enter, Key::Right}) {
        stage.press(key);
    }
    stage.type("jklgGy");
    EXPECT_EQ(stage.depth(), 2U);
    EXPECT_TRUE(stage.copied.empty());
}

TEST_F(FrontEndBrowsingTest, RightScrollsALongRowToItsEndAndLeftBackToItsStartThenGoesBack) {
    stage.tick(Dictionary{{"A", Dictionary{{"A name of 22 columns..", "a value of 20 column"}}}});
    stage.frontEnd.resize(40, 12);
    stage.press(Key::Home);
    stage.press(Key::Enter);
    EXPECT_EQ(stage.line(2), "▌A name of 22 columns..     a value o…");
    stage.press(Key::Right);
    EXPECT_EQ(stage.line(2), "▌f 22 columns..     a value of 20 col…");
    stage.type("l");
    EXPECT_EQ(stage.line(2), "▌umns..     a value of 20 column");
    // The layout's content exceeds the row by the width of both texts: 42 columns.
    stage.press(Key::Right, 9);
    EXPECT_EQ(stage.table().sidewaysOffset(), 42);
    EXPECT_EQ(stage.depth(), 2U); // a leaf opens nothing at the end
    stage.press(Key::Left, 3);
    stage.type("hhh");
    EXPECT_EQ(stage.line(2), "▌A name of 22 columns..     a value o…");
    EXPECT_EQ(stage.depth(), 2U);
    stage.press(Key::Left);
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndBrowsingTest, BackspaceGoesBackFromAScrolledRowAtOnce) {
    stage.tick(Dictionary{{"A", Dictionary{{"Long", std::string(200, 'v')}}}});
    stage.press(Key::Home);
    stage.press(Key::Enter);
    stage.press(Key::Right);
    ASSERT_GT(stage.table().sidewaysOffset(), 0);
    stage.press(Key::Backspace);
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndBrowsingTest, YCopiesTheValueAndShowsAMessageUntilTheNextKey) {
    stage.press(Key::End);
    stage.frontEnd.resize(80, 12);
    stage.type("y");
    EXPECT_EQ(stage.copied, (std::vector<std::string>{"Example"}));
    EXPECT_EQ(stage.line(11),
              " Copied: Example                                       / filter  s Save  ? help");
    stage.press(Key::Up);
    EXPECT_EQ(stage.line(11),
              " Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help");
}

TEST_F(FrontEndBrowsingTest, AMessageGoesAtAnyKeyAndTheKeyStillDoesItsOwn) {
    stage.frontEnd.setMessage("Saved");
    const int displays = stage.displays;
    stage.press(Key::Tab); // has no effect alone
    EXPECT_EQ(stage.displays, displays + 1);
    EXPECT_EQ(stage.screen().find("Saved"), std::string::npos);
    stage.frontEnd.setMessage("Saved");
    stage.click(5, 2);
    EXPECT_EQ(stage.depth(), 2U);
}

TEST_F(FrontEndBrowsingTest, YOnABranchCopiesItsName) {
    stage.type("y");
    EXPECT_EQ(stage.copied, (std::vector<std::string>{"Serving Cell Measurements"}));
}

TEST_F(FrontEndBrowsingTest, ControlLRepaintsAndChangesNothing) {
    stage.type("y");
    const std::string before = stage.screen();
    stage.pressControl('l');
    EXPECT_EQ(stage.repaints, 1);
    EXPECT_EQ(stage.screen(), before); // the message is also still shown
}

TEST_F(FrontEndBrowsingTest, SOpensTheSaveScreen) {
    stage.type("s");
    EXPECT_NE(stage.saveScreen(), nullptr);
}

TEST_F(FrontEndBrowsingTest, WithoutTheSaveButtonSShowsAMessage) {
    stage.savingAllowed = false;
    stage.tick(display());
    stage.frontEnd.resize(60, 12);
    stage.type("s");
    EXPECT_EQ(stage.saveScreen(), nullptr);
    EXPECT_EQ(stage.screen(60, 12), R"(
 Pallax
 ──────────────────────────────────────────────────────────
▌Serving Cell Measurements                                 ›
┌ Saving is not enabled here ──────────────────────────────┐
│ Two settings in pallax.conf enable it:                   │
│ snapshot-directory, where snapshots go, and              │
│ save-button-marker, a path that exists.                  │
│                                                [ Close ] │
└──────────────────────────────────────────────────────────┘

 ──────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20            / filter  ? help
)");
    EXPECT_EQ(faultOf(stage.frontEnd.draw()), "");
    stage.press(Key::Escape);
    EXPECT_EQ(stage.frontEnd.toolkit().alert(), nullptr);
}

TEST_F(FrontEndBrowsingTest, OtherKeysDoNothing) {
    const std::string known = "jklhgG/foe;ivVtsyRq?";
    const std::string before = stage.screen();
    const int displays = stage.displays;
    for (char32_t character = 0; character < 0x180; ++character) {
        const bool isKnown =
            character < 0x80 && known.find(static_cast<char>(character)) != std::string::npos;
        if (!isKnown && character != controlKey('l')) {
            stage.frontEnd.handle({.key = Key::Character, .character = character});
        }
    }
    for (const Key key : {Key::Delete, Key::Tab, Key::BackTab}) {
        stage.press(key);
    }
    EXPECT_EQ(stage.displays, displays);
    EXPECT_EQ(stage.screen(), before);
}

TEST_F(FrontEndBrowsingTest, TheCursorStaysOnItsRowWhileRowsComeAndGo) {
    stage.tick(Dictionary{{"B", "1"}, {"C", "2"}});
    stage.press(Key::Down);
    stage.frontEnd.resize(20, 9);
    stage.tick(Dictionary{{"A", "0"}, {"B", "1"}, {"C", "2"}, {"D", "3"}});
    EXPECT_EQ(stage.screen(), R"(
 Pallax
 ──────────────────
 A               0 *
 B               1
▌C               2
 D               3 *

 ──────────────────
 …11-14 at 22:13:20
)");
    stage.tick(Dictionary{{"C", "2"}});
    EXPECT_EQ(stage.cursorName(), "C");
}

TEST_F(FrontEndBrowsingTest, GoingBackFindsTheCursorWhereItWas) {
    stage.press(Key::Down);
    stage.press(Key::Enter);
    stage.press(Key::Down);
    stage.press(Key::Left);
    EXPECT_EQ(stage.cursorName(), "Measured Neighbor Cells");
}

TEST_F(FrontEndBrowsingTest, APaneWhosePathVanishesIsLeft) {
    stage.press(Key::Enter);
    stage.tick(Dictionary{{"Other", Dictionary{}}});
    EXPECT_EQ(stage.screen(20, 5), R"(
 Pallax
 gone: Serving Ce…─
▌Other             ›
 ──────────────────
 …11-14 at 22:13:20
)");
}

TEST_F(FrontEndBrowsingTest, TheSpinnerTurnsWhileThereIsNoConnection) {
    EXPECT_FALSE(stage.frontEnd.isAnimated());
    stage.tick({});
    EXPECT_TRUE(stage.frontEnd.isAnimated());
    stage.frontEnd.resize(30, 5);
    std::string turns;
    for (int turn = 0; turn < 5; ++turn) {
        turns += stage.line(4) + "\n";
        stage.frontEnd.turn();
    }
    EXPECT_EQ(turns, " ⠋ Connecting...       ? help\n"
                     " ⠹ Connecting...       ? help\n"
                     " ⠴ Connecting...       ? help\n"
                     " ⠧ Connecting...       ? help\n"
                     " ⠋ Connecting...       ? help\n");
}

TEST_F(FrontEndBrowsingTest, DrawingAsksForNoOtherDrawing) {
    const int displays = stage.displays;
    for (const auto& [columns, rows] : {std::pair{80, 24}, {40, 12}, {20, 5}, {1, 1}, {0, 0}}) {
        stage.frontEnd.resize(columns, rows);
        (void)stage.frontEnd.draw();
        (void)stage.frontEnd.draw();
    }
    EXPECT_EQ(stage.displays, displays + 5); // one for each new size
}

TEST_F(FrontEndBrowsingTest, AScreenThatIsTooSmallSaysWhatItNeeds) {
    EXPECT_EQ(stage.screen(19, 5), "\nPallax needs 20x5\n\n\n\n\n");
    EXPECT_EQ(stage.screen(20, 4), "\nPallax needs 20x5\n\n\n\n");
    EXPECT_EQ(stage.screen(1, 1), "\n2\n");
    EXPECT_EQ(stage.screen(0, 0), "\n");
    EXPECT_EQ(stage.screen(20, 5), R"(
 Pallax
 ──────────────────
▌Serving Cell Mea… ›
 ──────────── ↓ 4 ─
 …11-14 at 22:13:20
)");
}

} // namespace
} // namespace pallax::terminal
