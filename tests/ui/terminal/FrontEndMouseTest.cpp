#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

class FrontEndMouseTest : public StageFixture {
protected:
    FrontEndMouseTest() {
        stage.tick(display());
        stage.saveHistory = snapshotItems();
        stage.frontEnd.resize(60, 12);
    }
    /// Clicks the first occurrence of this text on the screen.
    void clickOn(const std::string& text) {
        const Grid grid = draw();
        for (int y = 0; y < grid.rows(); ++y) {
            std::string line;
            for (int x = 0; x < grid.columns(); ++x) {
                line = "";
                for (int at = x; at < grid.columns(); ++at) {
                    line += grid.at(at, y).text;
                }
                if (line.compare(0, text.size(), text) == 0) {
                    stage.mouse(Key::Click, x, y);
                    return;
                }
            }
        }
        FAIL() << text << " is not on the screen";
    }
    bool isEditing() { return draw().cursor().has_value(); }
};

TEST_F(FrontEndMouseTest, AClickOpensABranch) {
    stage.click(30, 3);
    EXPECT_EQ(stage.line(0), " Pallax › Measured Neighbor Cells");
    stage.press(Key::Left);
    EXPECT_EQ(stage.cursorName(), "Measured Neighbor Cells");
}

TEST_F(FrontEndMouseTest, AClickMovesTheCursorToALeaf) {
    clickOn("Operator");
    EXPECT_EQ(stage.cursorName(), "Operator");
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndMouseTest, AClickMeansTheRowThatIsSeenUnderAFilter) {
    stage.type("/info");
    stage.press(Key::Enter);
    stage.click(5, 2);
    EXPECT_EQ(stage.line(0), " Pallax › SIM Info");
}

TEST_F(FrontEndMouseTest, AClickMeansTheRowThatIsSeenInAScrolledTable) {
    stage.frontEnd.resize(60, 6); // two rows
    stage.press(Key::End);
    stage.click(5, 2);
    EXPECT_EQ(stage.line(0), " Pallax › SIM Info");
}

TEST_F(FrontEndMouseTest, AClickOnNothingDoesNothing) {
    const std::string before = stage.screen();
    for (const auto& place :
         {Position{5, 0}, {5, 1}, {5, 8}, {5, 10}, {5, 11}, {-1, 3}, {60, 3}, {5, 99}, {-7, -7}}) {
        stage.click(place.x, place.y);
    }
    EXPECT_EQ(stage.screen(), before);
}

TEST_F(FrontEndMouseTest, AClickOnAHintDoesWhatItsKeyDoes) {
    stage.frontEnd.resize(80, 24);
    clickOn("/ filter");
    EXPECT_TRUE(isEditing());
    stage.type("info");
    clickOn("Esc clear filter"); // beside the prompt
    EXPECT_FALSE(isEditing());
    EXPECT_EQ(stage.pane().filter(), "");
    stage.type("/info");
    stage.press(Key::Enter);
    clickOn("Esc clear filter"); // in the toolbar
    EXPECT_EQ(stage.pane().filter(), "");
    clickOn("? help");
    EXPECT_NE(stage.screen().find("┌ Keys"), std::string::npos);
    stage.press(Key::Escape);
    clickOn("s Save");
    EXPECT_NE(stage.saveScreen(), nullptr);
}

TEST_F(FrontEndMouseTest, AClickOnATitleGoesBackToItsPane) {
    stage.tick(Dictionary{{"Outer", Dictionary{{"Middle", Dictionary{{"Inner", Dictionary{}}}}}}});
    stage.press(Key::Enter, 3);
    ASSERT_EQ(stage.line(0), " Pallax › Outer › Middle › Inner");
    clickOn("Inner");
    clickOn("› Inner"); // between two of them
    EXPECT_EQ(stage.depth(), 4U);
    clickOn("Outer");
    EXPECT_EQ(stage.line(0), " Pallax › Outer");
    clickOn("Pallax");
    EXPECT_EQ(stage.line(0), " Pallax");
    stage.press(Key::Enter, 3);
    stage.frontEnd.resize(20, 8);
    ASSERT_EQ(stage.line(0), " … › Middle › Inner");
    clickOn("…");
    EXPECT_EQ(stage.line(0), " Pallax › Outer");
}

TEST_F(FrontEndMouseTest, AClickThatComesBeforeTheNextDrawingDoesNothing) {
    stage.click(5, 2);
    ASSERT_EQ(stage.depth(), 2U);
    stage.mouse(Key::Click, 5, 2); // nothing is there now
    EXPECT_EQ(stage.depth(), 2U);
    stage.press(Key::Left);
    EXPECT_EQ(stage.depth(), 1U);
    (void)draw();
    stage.tick(Dictionary{{"Other", Dictionary{}}});
    stage.mouse(Key::Click, 5, 2);
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndMouseTest, AClickOnAScreenThatIsTooSmallDoesNothing) {
    stage.frontEnd.resize(19, 5);
    stage.click(5, 2);
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndMouseTest, TheSaveHintIsAButton) {
    clickOn("s Save");
    EXPECT_NE(stage.saveScreen(), nullptr);
}

TEST_F(FrontEndMouseTest, TheWheelMovesTheCursorByThreeRows) {
    stage.mouse(Key::WheelDown, 5, 5);
    EXPECT_EQ(stage.cursorName(), "SIM Info");
    stage.mouse(Key::WheelDown, 5, 5);
    EXPECT_EQ(stage.cursorName(), "Operator");
    stage.mouse(Key::WheelUp, 5, 5);
    EXPECT_EQ(stage.cursorName(), "Measured Neighbor Cells");
    stage.mouse(Key::WheelUp, 5, 5);
    EXPECT_EQ(stage.cursorName(), "Serving Cell Measurements");
}

TEST_F(FrontEndMouseTest, TheWheelWorksWhileAFilterIsTyped) {
    stage.type("/e");
    stage.mouse(Key::WheelDown, 5, 5);
    EXPECT_EQ(stage.pane().cursor(), 3U);
    EXPECT_EQ(stage.pane().filter(), "e");
}

TEST_F(FrontEndMouseTest, AClickOnSaveSaves) {
    stage.type("stext");
    clickOn("[ Save ]");
    stage.queue.runReady();
    EXPECT_EQ(stage.files.files.size(), 1U);
    EXPECT_EQ(stage.saveScreen(), nullptr);
}

TEST_F(FrontEndMouseTest, AClickOnCancelCancels) {
    stage.type("s");
    clickOn("[ Cancel ]");
    stage.queue.runReady();
    EXPECT_TRUE(stage.files.files.empty());
    EXPECT_EQ(stage.saveScreen(), nullptr);
}

TEST_F(FrontEndMouseTest, AClickOnTheBackgroundOrAnItemEndsEditingAndOnTheFieldBeginsIt) {
    stage.type("s");
    ASSERT_TRUE(isEditing());
    stage.click(0, 11);
    EXPECT_FALSE(isEditing());
    clickOn("Description");
    EXPECT_TRUE(isEditing());
    clickOn("DLF binary");
    EXPECT_FALSE(isEditing());
    EXPECT_NE(stage.saveScreen(), nullptr);
}

TEST_F(FrontEndMouseTest, NothingBelowTheSaveScreenCanBeClicked) {
    stage.type("s");
    stage.click(5, 0);
    stage.click(56, 11); // the place of the help hint
    stage.click(45, 11); // and of the save hint
    stage.queue.runReady();
    EXPECT_EQ(stage.depth(), 1U);
    EXPECT_NE(stage.saveScreen(), nullptr);
    EXPECT_TRUE(stage.files.files.empty());
}

TEST_F(FrontEndMouseTest, TheWheelLeavesThePaneBelowTheSaveScreenAlone) {
    stage.type("s");
    stage.mouse(Key::WheelDown, 5, 5);
    EXPECT_EQ(stage.cursorName(), "Serving Cell Measurements");
}

TEST_F(FrontEndMouseTest, AClickAnywhereClosesAnAlertAndNothingElse) {
    stage.frontEnd.toolkit().showAlert({"Title", "Message", "Close"});
    stage.click(5, 2);
    EXPECT_EQ(stage.frontEnd.toolkit().alert(), nullptr);
    EXPECT_EQ(stage.depth(), 1U);
}

} // namespace
} // namespace pallax::terminal
