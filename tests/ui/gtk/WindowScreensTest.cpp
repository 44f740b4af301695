#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"
#include "tests/ui/terminal/StageData.h"

namespace pallax::gtk {
namespace {

using terminal::display;

class WindowScreens : public DisplayTest {};

TEST_F(WindowScreens, BeforeTheFirstDataThePaneIsEmptyAndTheSpinnerTurns) {
    WindowStage stage(360, 720);
    stage.savingAllowed = false;
    stage.tick(PropertyList());
    EXPECT_EQ(stage.dump(), R"(
title: Pallax / 
spinner: turns
text: Connecting...
)");
}

TEST_F(WindowScreens, OnAPhoneThereIsOnePane) {
    WindowStage stage(360, 720);
    stage.tick(display());
    EXPECT_EQ(stage.dump(), R"(
title: Pallax / 
row: Serving Cell Measurements (at 10) [go-next-symbolic]
row: Measured Neighbor Cells (at 10) 3 [go-next-symbolic]
row: Empty List (at 10) [go-next-symbolic]
row: SIM Info (at 10) [go-next-symbolic]
row: Operator (at 10) | Example (flush right)
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
    stage.select(0);
    EXPECT_EQ(stage.dump(), R"(
button: Back
title: Serving Cell Measurements / 
row: Version (at 10) | 1 (flush right)
row: E-ARFCN (at 10) | 1850 (flush right)
row: Physical Cell ID (at 10) | 274 (flush right)
row: Measured RSRP (at 10) | -94.75 dBm (flush right)
row: Average RSRP (at 10) | -95.00 dBm (flush right)
row: Measured RSRQ (at 10) | -9.50 dB (flush right)
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
}

const char* const kSideBySide = R"(
button: Back
button: Show as Table
title: Measured Neighbor Cells / 
row: 0 (at 10) [go-next-symbolic]
row: 1 (at 10) [go-next-symbolic]
row: 2 (at 10) [go-next-symbolic]
row: Serving Cell Measurements (at 10) [go-next-symbolic]
row: Measured Neighbor Cells (at 10) 3 [go-next-symbolic], open
row: Empty List (at 10) [go-next-symbolic]
row: SIM Info (at 10) [go-next-symbolic]
row: Operator (at 10) | Example (flush right)
text: Updated 2023-11-14 at 22:13:20
button: Save
)";

TEST_F(WindowScreens, WhereThereIsRoomTheRootPaneStandsBesideTheTopmostOne) {
    for (const auto& [width, height] : {std::pair(720, 360), std::pair(1024, 768)}) {
        WindowStage stage(width, height);
        stage.tick(display());
        stage.select(1);
        EXPECT_EQ(stage.dump(), kSideBySide) << width;
    }
}

TEST_F(WindowScreens, AnotherRowOfTheRootPaneReplacesThePanesBesideIt) {
    WindowStage stage(1024, 768);
    stage.tick(display());
    stage.select(1);
    stage.select(0);
    EXPECT_EQ(stage.depth(), 3U);
    stage.select(3, 0);
    EXPECT_EQ(stage.depth(), 2U);
    EXPECT_EQ(stage.dump(), R"(
button: Back
title: SIM Info / 
row: IMSI (at 10) | 001010123456789 (flush right)
row: Serving Cell Measurements (at 10) [go-next-symbolic]
row: Measured Neighbor Cells (at 10) 3 [go-next-symbolic]
row: Empty List (at 10) [go-next-symbolic]
row: SIM Info (at 10) [go-next-symbolic], open
row: Operator (at 10) | Example (flush right)
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
}

TEST_F(WindowScreens, AWindowThatIsMadeNarrowShowsTheTopmostPane) {
    WindowStage stage(1024, 768);
    stage.tick(display());
    stage.select(3);
    stage.resize(360, 720);
    EXPECT_EQ(stage.dump(), R"(
button: Back
title: SIM Info / 
row: IMSI (at 10) | 001010123456789 (flush right)
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
    stage.resize(1024, 768);
    EXPECT_NE(stage.dump().find("SIM Info (at 10) [go-next-symbolic], open"), std::string::npos);
}

TEST_F(WindowScreens, BackLeavesTheTopmostPane) {
    WindowStage stage(360, 720);
    stage.tick(display());
    const std::string root = stage.dump();
    stage.select(1);
    stage.select(2);
    EXPECT_EQ(stage.depth(), 3U);
    stage.press("Back");
    EXPECT_EQ(stage.depth(), 2U);
    stage.press("Back");
    EXPECT_EQ(stage.dump(), root);
}

TEST_F(WindowScreens, AVanishedPathPopsBackToThePaneBelow) {
    WindowStage stage(360, 720);
    stage.tick(display());
    stage.select(1);
    stage.select(2);
    stage.tick(
        Dictionary{{"Measured Neighbor Cells", Array{Dictionary{{"Physical Cell ID", "275"}}}}});
    EXPECT_EQ(stage.dump(), R"(
button: Back
button: Show as Table
title: Measured Neighbor Cells / 
row: 0 (at 10) [go-next-symbolic]
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
}

TEST_F(WindowScreens, ALeafOpensNothing) {
    WindowStage stage(360, 720);
    stage.tick(display());
    stage.select(4);
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(WindowScreens, AValueThatDoesNotFitFollowsItsNameAndTheRowScrolls) {
    WindowStage stage(360, 720);
    const std::string value(60, 'w');
    stage.tick(Dictionary{{"Name", value.c_str()}, {"Other", "1"}});
    EXPECT_EQ(stage.dump(), R"(
title: Pallax / 
row: Name (at 10) | wwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwwww (50 behind), scrolls
row: Other (at 10) | 1 (flush right)
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
}

TEST_F(WindowScreens, TextsFromModemsAreNeitherMarkupNorControl) {
    WindowStage stage(360, 720);
    stage.tick(Dictionary{{"<b>a</b>&", "\x1B[1m\u202Eb"}, {"<i>", Dictionary{{"x", "y"}}}});
    stage.select(1);
    stage.press("Back");
    EXPECT_EQ(stage.dump(), R"(
title: Pallax / 
row: <b>a</b>& (at 10) | \x1B[1m\u202Eb (flush right)
row: <i> (at 10) [go-next-symbolic]
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
}

TEST_F(WindowScreens, DarkAndLightShowTheSame) {
    const auto foreground = [](const WindowStage& stage) {
        GdkRGBA color;
        gtk_style_context_get_color(gtk_widget_get_style_context(stage.window()), &color);
        return color.red;
    };
    AdwStyleManager* manager = adw_style_manager_get_default();
    WindowStage stage(1024, 768);
    stage.tick(display());
    stage.select(1);
    EXPECT_LT(foreground(stage), 0.5);
    adw_style_manager_set_color_scheme(manager, ADW_COLOR_SCHEME_FORCE_DARK);
    stage.settle();
    EXPECT_EQ(stage.dump(), kSideBySide);
    EXPECT_GT(foreground(stage), 0.5);
    adw_style_manager_set_color_scheme(manager, ADW_COLOR_SCHEME_DEFAULT);
}

TEST_F(WindowScreens, EverythingGrowsWithTheUsersTexts) {
    WindowStage stage(600, 720);
    stage.tick(display());
    GtkSettings* settings = gtk_settings_get_default();
    gint usual = 0;
    g_object_get(settings, "gtk-xft-dpi", &usual, nullptr);
    constexpr int kTwice = 2 * 96 * 1024;
    g_object_set(settings, "gtk-xft-dpi", kTwice, nullptr);
    stage.settle();
    stage.settle();
    EXPECT_EQ(stage.dump(), R"(
title: Pallax / 
row: Serving Cell Measurements (at 20) [go-next-symbolic], 100 high
row: Measured Neighbor Cells (at 20) 3 [go-next-symbolic], 100 high
row: Empty List (at 20) [go-next-symbolic], 100 high
row: SIM Info (at 20) [go-next-symbolic], 100 high
row: Operator (at 20) | Example (flush right), 100 high
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
    g_object_set(settings, "gtk-xft-dpi", usual, nullptr);
}

} // namespace
} // namespace pallax::gtk
