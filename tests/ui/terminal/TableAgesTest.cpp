#include "tests/ui/pages/ValueStage.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

constexpr const char* kList = "Neighbor Cells List";

/// The neighbours of a drive as a table, whose last column tells their ages.
class TableAgesTest : public ValueStage {
protected:
    void open(std::uint64_t instant) {
        stage.frontEnd.showListsAsTables(true);
        show(instant);
        stage.type("/");
        stage.type(kList);
        stage.press(Key::Home);
        stage.press(Key::Enter);
        stage.press(Key::Enter);
        (void)stage.screen(80, 8);
    }
    void chooseLast() { stage.type(">>>>>>>>>>>>>>>>>>>>"); }
};

TEST_F(TableAgesTest, TheColumnIsShownWhenItIsChosen) {
    open(last());
    EXPECT_FALSE(shows(" age"));
    chooseLast();
    EXPECT_EQ(stage.screen(), R"(
 Pallax › Neighbor Cells List                                         2 entries
 ──────────────────────────────────────────────────────────────────────────────
 Ant 0 Sample Offset  Ant 1 Frame Offset  Ant 1 Sample Offset  age↑
▌              67411                 206                67411  1 s
               59678                 769                59678  1 s

 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20     r reverse  t rows  / filter  s Save  ? help
)");
    stage.type("<");
    EXPECT_FALSE(shows(" age"));
}

TEST_F(TableAgesTest, AgesGrowWhileNothingArrives) {
    open(last());
    chooseLast();
    EXPECT_TRUE(shows("  1 s\n")) << stage.screen();
    stage.displayTime.now += std::chrono::seconds(20);
    EXPECT_TRUE(shows("  21 s\n")) << stage.screen();
}

TEST_F(TableAgesTest, WithoutValuesThereIsNone) {
    open(last());
    stage.moment = {};
    stage.tick(drive.timeline->displayAt(last()));
    chooseLast();
    EXPECT_FALSE(shows(" age")) << stage.screen();
}

} // namespace
} // namespace pallax::terminal
