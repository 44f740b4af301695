#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

namespace pallax::terminal {
namespace {

class FrontEndAlertTest : public StageFixture {
protected:
    FrontEndAlertTest() {
        stage.tick(display());
        stage.press(Key::Enter);
    }
    void alert(const char* title = "File Error") {
        stage.frontEnd.toolkit().showAlert({title, "Unable to write file to disk", "Close"});
    }
    bool isOpen() { return stage.frontEnd.toolkit().alert() != nullptr; }
};

TEST_F(FrontEndAlertTest, AnAlertLiesOverThePane) {
    alert();
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────────────────────────────────────────────────────
▌Version                                                                     1
 E-ARFCN                                                                  1850
 Physical Cell ID                                                          274
 Measured RSRP                                                      -94.75 dBm
 Average RSRP                                                       -95.00 dBm
 Measured RSRQ                                                        -9.50 dB


                       ┌ File Error ────────────────────┐
                       │ Unable to write file to disk   │
                       │                      [ Close ] │
                       └────────────────────────────────┘








 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
    EXPECT_EQ(stage.screen(40, 12), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────────────
▌Version                             1
 E-ARFCN                          1850
 Ph┌ File Error ────────────────────┐4
 Me│ Unable to write file to disk   │m
 Av│                      [ Close ] │m
 Me└────────────────────────────────┘B


 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
    EXPECT_EQ(stage.screen(20, 5), R"(
┌ File Error ──────┐
│ Unable to write  │
│ file to disk     │
│        [ Close ] │
└──────────────────┘
)");
}

TEST_F(FrontEndAlertTest, EnterEscSpaceQAndAClickCloseIt) {
    for (const auto& closing :
         {KeyEvent{.key = Key::Enter}, KeyEvent{.key = Key::Escape}, KeyEvent{.key = Key::Click},
          KeyEvent{.key = Key::Character, .character = U' '},
          KeyEvent{.key = Key::Character, .character = U'q'}}) {
        alert();
        (void)stage.frontEnd.draw();
        stage.frontEnd.handle(closing);
        EXPECT_FALSE(isOpen());
        EXPECT_EQ(stage.depth(), 2U); // the panes below got no key
    }
    EXPECT_EQ(stage.quits, 0);
}

TEST_F(FrontEndAlertTest, AnyOtherKeyDoesNothing) {
    alert();
    const std::string before = stage.screen();
    for (const Key key : {Key::Up, Key::Down, Key::Left, Key::Right, Key::PageUp, Key::PageDown,
                          Key::Home, Key::End, Key::Tab, Key::BackTab, Key::Backspace, Key::Delete,
                          Key::WheelUp, Key::WheelDown}) {
        stage.press(key);
    }
    stage.type("jkhlgG/sy?x");
    EXPECT_EQ(stage.screen(), before);
}

TEST_F(FrontEndAlertTest, AnAlertLiesOverTheSaveScreenToo) {
    stage.type("s");
    alert();
    stage.frontEnd.resize(40, 12);
    EXPECT_EQ(stage.line(4), "│  ┌ File Error ────────────────────┐  │");
    stage.press(Key::Escape);
    EXPECT_FALSE(isOpen());
    EXPECT_NE(stage.saveScreen(), nullptr); // the alert took Esc
}

TEST_F(FrontEndAlertTest, AnAlertLiesOverTheHelpPageToo) {
    stage.type("?");
    stage.frontEnd.resize(40, 12);
    alert();
    EXPECT_EQ(stage.line(4), " P│┌ File Error ────────────────────┐4");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.line(0), " P┌ Keys ───────────────────────────┐");
}

TEST_F(FrontEndAlertTest, SeveralAlertsAreClosedOneByOne) {
    alert("First");
    alert("Second");
    stage.frontEnd.resize(40, 12);
    EXPECT_EQ(stage.line(4), " Ph┌ First ─────────────────────────┐4");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.line(4), " Ph┌ Second ────────────────────────┐4");
    stage.press(Key::Enter);
    EXPECT_FALSE(isOpen());
}

} // namespace
} // namespace pallax::terminal
