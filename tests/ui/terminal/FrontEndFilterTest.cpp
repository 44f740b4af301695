#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

namespace pallax::terminal {
namespace {

class FrontEndFilterTest : public StageFixture {
protected:
    FrontEndFilterTest() {
        stage.tick(display());
        stage.press(Key::Enter);
        stage.frontEnd.resize(40, 12);
    }
};

TEST_F(FrontEndFilterTest, RowsGoAndComeWithEveryCharacter) {
    stage.type("/");
    EXPECT_EQ(stage.pane().shownRows(), 6U);
    stage.type("-9");
    EXPECT_EQ(stage.pane().shownRows(), 3U); // by value
    stage.type("5");
    EXPECT_EQ(stage.screen(), R"(
 … › Serving Cell Measurements   1 of 6
 ──────────────────────────────────────
▌Average RSRP               -95.00 dBm







 ──────────────────────────────────────
 / -95                 Esc clear filter
)");
    stage.press(Key::Backspace);
    EXPECT_EQ(stage.pane().shownRows(), 3U);
}

TEST_F(FrontEndFilterTest, TheCaseOfLettersDoesNotMatter) {
    stage.type("/VeRsIoN");
    EXPECT_EQ(stage.cursorName(), "Version");
    EXPECT_EQ(stage.pane().shownRows(), 1U);
}

TEST_F(FrontEndFilterTest, ARowWithoutAMatchIsNotShown) {
    stage.type("/no such row");
    EXPECT_EQ(stage.screen(20, 5), R"(
 … › Servin… 0 of 6
 ──────────────────

 ──────────────────
 / no such row
)");
}

TEST_F(FrontEndFilterTest, EscClearsTheFilter) {
    stage.type("/rsrp");
    stage.press(Key::Escape);
    EXPECT_EQ(stage.pane().filter(), "");
    EXPECT_EQ(stage.depth(), 2U);
    EXPECT_EQ(stage.line(11), " Updated 2023-11-14 at 22:13:20  ? help");
    EXPECT_EQ(draw().cursor(), std::nullopt);
}

TEST_F(FrontEndFilterTest, EnterKeepsTheFilterAndEscClearsItLaterBeforeItGoesBack) {
    stage.type("/rsrp");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.pane().filter(), "rsrp");
    stage.type("j"); // goes to the pane again
    EXPECT_EQ(stage.cursorName(), "Average RSRP");
    stage.press(Key::Escape);
    EXPECT_EQ(stage.pane().filter(), "");
    EXPECT_EQ(stage.cursorName(), "Average RSRP");
    EXPECT_EQ(stage.depth(), 2U);
    stage.press(Key::Escape);
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndFilterTest, BackspaceOnAnEmptyFilterEndsIt) {
    stage.type("/r");
    stage.press(Key::Backspace);
    EXPECT_EQ(stage.line(11), " /                     Esc clear filter");
    stage.press(Key::Backspace);
    EXPECT_EQ(stage.line(11), " Updated 2023-11-14 at 22:13:20  ? help");
    EXPECT_EQ(stage.depth(), 2U);
}

TEST_F(FrontEndFilterTest, SlashGoesOnWithTheFilterThatThereIs) {
    stage.type("/rs");
    stage.press(Key::Enter);
    stage.type("/rq");
    EXPECT_EQ(stage.pane().filter(), "rsrq");
    EXPECT_EQ(stage.cursorName(), "Measured RSRQ");
}

TEST_F(FrontEndFilterTest, ArrowsAndPagesMoveAmongTheRowsWhileItIsTyped) {
    stage.type("/r");
    ASSERT_EQ(stage.pane().shownRows(), 5U);
    (void)stage.frontEnd.draw();
    stage.press(Key::Down);
    EXPECT_EQ(stage.pane().cursor(), 1U);
    stage.press(Key::PageDown);
    EXPECT_EQ(stage.pane().cursor(), 4U);
    stage.press(Key::Up);
    EXPECT_EQ(stage.pane().cursor(), 3U);
    stage.press(Key::PageUp);
    EXPECT_EQ(stage.pane().cursor(), 0U);
    EXPECT_EQ(stage.pane().filter(), "r");
}

TEST_F(FrontEndFilterTest, OtherKeysEditItsText) {
    stage.type("/srp");
    stage.press(Key::Home);
    stage.type("R");
    EXPECT_EQ(stage.pane().filter(), "Rsrp");
    stage.press(Key::End);
    stage.pressControl('u');
    EXPECT_EQ(stage.pane().filter(), "");
    stage.type("jkhlgGqs?/y漢");
    EXPECT_EQ(stage.pane().filter(), "jkhlgGqs?/y漢");
    stage.press(Key::Tab);
    EXPECT_EQ(stage.pane().filter(), "jkhlgGqs?/y漢");
    EXPECT_EQ(stage.quits, 0);
    EXPECT_EQ(stage.saveScreen(), nullptr);
}

TEST_F(FrontEndFilterTest, NewDataIsFilteredAndTheCursorStaysOnItsRow) {
    stage.type("/rsrp");
    stage.press(Key::Down);
    stage.tick(
        Dictionary{{"Serving Cell Measurements", Dictionary{{"RSRP of antenna 0", "-90 dBm"},
                                                            {"Version", "1"},
                                                            {"Measured RSRP", "-94.75 dBm"},
                                                            {"Average RSRP", "-95.00 dBm"}}}});
    EXPECT_EQ(stage.screen(), R"(
 … › Serving Cell Measurements   3 of 4
 gone: E-ARFCN, Physical Cell ID, Mea…─
 RSRP of antenna 0             -90 dBm *
 Measured RSRP              -94.75 dBm
▌Average RSRP               -95.00 dBm





 ──────────────────────────────────────
 / rsrp                Esc clear filter
)");
}

TEST_F(FrontEndFilterTest, TypingEndsWhenAClickOpensAnotherPane) {
    stage.press(Key::Left);
    stage.type("/info");
    stage.click(5, 2);
    EXPECT_EQ(stage.screen(20, 5), R"(
 Pallax › SIM Info
 ──────────────────
▌IMSI     0010101…
 ──────────────────
 …11-14 at 22:13:20
)");
    EXPECT_EQ(draw().cursor(), std::nullopt);
    stage.type("q");
    EXPECT_EQ(stage.depth(), 1U);
    EXPECT_EQ(stage.pane().filter(), "info"); // kept, but no longer edited
    EXPECT_EQ(stage.line(4), " …11-14 at 22:13:20");
}

TEST_F(FrontEndFilterTest, TypingEndsWhenItsPaneIsGone) {
    stage.type("/rs");
    stage.tick(Dictionary{{"A", "1"}, {"B", "2"}});
    ASSERT_EQ(stage.depth(), 1U);
    stage.type("j");
    EXPECT_EQ(stage.pane().filter(), "");
    EXPECT_EQ(stage.cursorName(), "B");
    EXPECT_EQ(draw().cursor(), std::nullopt);
}

TEST_F(FrontEndFilterTest, EveryPaneHasItsOwnFilter) {
    stage.press(Key::Left);
    stage.type("/cell");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.pane().shownRows(), 2U);
    stage.press(Key::Enter);
    EXPECT_EQ(stage.pane().shownRows(), 6U);
    EXPECT_EQ(stage.pane().filter(), "");
    stage.press(Key::Left);
    EXPECT_EQ(stage.pane().filter(), "cell");
}

} // namespace
} // namespace pallax::terminal
