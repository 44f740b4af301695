#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

/// Every screen can be reached and left with the mouse alone, and with keys alone.
class FrontEndAloneTest : public StageFixture {
protected:
    FrontEndAloneTest() {
        stage.saveHistory = snapshotItems();
        stage.frontEnd.setOrigin({"Zorell_LTE", "drive.pcap"});
        stage.frontEnd.resize(80, 24);
        stage.tick(display());
    }

    /// Clicks on the first place of this ASCII text.
    void clickOn(const std::string& text) {
        const Grid grid = draw();
        for (int y = 0; y < grid.rows(); ++y) {
            for (int x = 0; x + static_cast<int>(text.size()) <= grid.columns(); ++x) {
                std::string found;
                for (int at = x; at < x + static_cast<int>(text.size()); ++at) {
                    found += grid.at(at, y).text;
                }
                if (found == text) {
                    return stage.mouse(Key::Click, x, y);
                }
            }
        }
        FAIL() << text << " is not on the screen" << stage.screen();
    }
    bool shows(const std::string& text) { return stage.screen().find(text) != std::string::npos; }
};

TEST_F(FrontEndAloneTest, TheMouseReachesAndLeavesEveryScreen) {
    clickOn("Serving Cell Measurements");
    EXPECT_EQ(stage.depth(), 2U);
    stage.mouse(Key::WheelDown, 5, 5);
    EXPECT_EQ(stage.cursorName(), "Measured RSRP");
    clickOn("Pallax");
    EXPECT_EQ(stage.depth(), 1U);

    clickOn("Zorell_LTE");
    EXPECT_TRUE(shows("Pallax › Overview"));
    stage.mouse(Key::WheelDown, 5, 5);
    clickOn("o panes");
    EXPECT_FALSE(shows("Overview"));
    clickOn("Zorell_LTE");
    clickOn("Zorell_LTE");
    EXPECT_FALSE(shows("Overview"));

    clickOn("? help");
    EXPECT_TRUE(shows("┌ Keys"));
    stage.mouse(Key::WheelDown, 5, 5);
    stage.click(5, 5);
    EXPECT_FALSE(shows("┌ Keys"));

    clickOn("s Save");
    ASSERT_NE(stage.saveScreen(), nullptr);
    stage.mouse(Key::WheelDown, 5, 5);
    clickOn("[ Cancel ]");
    stage.queue.runReady();
    EXPECT_EQ(stage.saveScreen(), nullptr);

    stage.frontEnd.toolkit().showAlert({"Title", "Message", "Close"});
    stage.click(5, 5);
    EXPECT_EQ(stage.frontEnd.toolkit().alert(), nullptr);

    clickOn("/ filter");
    EXPECT_TRUE(shows("Esc clear filter"));
    clickOn("Zorell_LTE");
    EXPECT_EQ(stage.pane().filter(), "") << "a click types nothing";
    clickOn("Esc clear filter");
    EXPECT_FALSE(shows("Esc clear filter"));
    EXPECT_EQ(stage.quits, 0);
}

TEST_F(FrontEndAloneTest, KeysReachAndLeaveEveryScreen) {
    stage.press(Key::Enter);
    EXPECT_EQ(stage.depth(), 2U);
    stage.press(Key::Down, 3);
    EXPECT_EQ(stage.cursorName(), "Measured RSRP");
    stage.press(Key::Backspace);
    EXPECT_EQ(stage.depth(), 1U);

    stage.type("o");
    EXPECT_TRUE(shows("Pallax › Overview"));
    stage.press(Key::PageDown);
    stage.press(Key::Escape);
    EXPECT_FALSE(shows("Overview"));

    stage.type("?");
    EXPECT_TRUE(shows("┌ Keys"));
    stage.press(Key::PageDown);
    stage.press(Key::Escape);
    EXPECT_FALSE(shows("┌ Keys"));

    stage.type("s");
    ASSERT_NE(stage.saveScreen(), nullptr);
    stage.press(Key::PageDown);
    stage.press(Key::Escape);
    stage.queue.runReady();
    EXPECT_EQ(stage.saveScreen(), nullptr);

    stage.frontEnd.toolkit().showAlert({"Title", "Message", "Close"});
    stage.press(Key::Enter);
    EXPECT_EQ(stage.frontEnd.toolkit().alert(), nullptr);

    stage.type("/x");
    EXPECT_TRUE(shows("Esc clear filter"));
    stage.press(Key::Escape);
    EXPECT_FALSE(shows("Esc clear filter"));
    stage.type("q");
    EXPECT_EQ(stage.quits, 1);
}

} // namespace
} // namespace pallax::terminal
