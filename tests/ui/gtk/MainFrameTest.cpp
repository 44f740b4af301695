#include "ui/gtk/MainFrame.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"
#include "tests/ui/terminal/StageData.h"
#include "ui/gtk/Menu.h"

namespace pallax::gtk {
namespace {

class MainFrameTest : public DisplayTest {};

TEST_F(MainFrameTest, TellsTheOriginTheRemarksAndOldValues) {
    WindowStage stage(360, 720);
    stage.frame.setOrigin("Zorell_LTE", "drive <1>.pcap");
    stage.frame.remarks().setNote("End of the recording");
    stage.frame.remarks().setStream("no data for 7 s");
    stage.frame.remarks().setAlarms({"weak", "gone"});
    stage.frame.setOldValues("22:13:30");
    stage.tick(Dictionary{});
    EXPECT_EQ(stage.dump(), R"(
title: Pallax / Zorell_LTE · drive <1>.pcap
text: The link was restarted: values from before 22:13:30
text: Updated 2023-11-14 at 22:13:20
text: alarm: weak, gone · no data for 7 s · End of the recording
button: Save
)");
    stage.frame.setOldValues("");
    stage.frame.remarks().setNote("");
    stage.frame.remarks().setStream("");
    stage.frame.remarks().setAlarms({});
    stage.frame.setOrigin("", "live modem");
    stage.settle();
    EXPECT_EQ(stage.dump(), R"(
title: Pallax / live modem
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
}

TEST_F(MainFrameTest, APageTellsWhyNothingComesAnyMore) {
    WindowStage stage(360, 720);
    stage.frame.showEnded("packet 2 (log code 0xFF0000): <broken>");
    stage.settle();
    EXPECT_EQ(stage.dump(), R"(
text: Pallax
text: Pallax has stopped
text: packet 2 (log code 0xFF0000): <broken>
button: Close (focus)
)");
    stage.press("Close");
    EXPECT_EQ(stage.closings, 1);
}

TEST_F(MainFrameTest, TheSearchShowsRowsThatContainTheText) {
    WindowStage stage(360, 720);
    stage.tick(terminal::display());
    stage.frame.toggleSearch();
    gtk_editable_set_text(GTK_EDITABLE(WindowStage::below(stage.window(), GTK_TYPE_SEARCH_ENTRY)),
                          "sim");
    stage.settle();
    EXPECT_NE(stage.dump().find("row: SIM Info"), std::string::npos);
    EXPECT_EQ(stage.dump().find("row: Operator"), std::string::npos);
    stage.select(0);
    EXPECT_NE(stage.dump().find("row: IMSI"), std::string::npos)
        << "the row that is seen is opened";
    stage.press("Back");
    stage.frame.toggleSearch();
    stage.settle();
    EXPECT_NE(stage.dump().find("row: Operator"), std::string::npos);
}

TEST_F(MainFrameTest, TheMenuRunsActionsOfTheWindow) {
    WindowStage stage(360, 720);
    bool isOn = false;
    int opened = 0;
    stage.frame.setMenu(
        menuButton(stage.frame.window(), stage.guard,
                   {{{"open", "Open…", [&] { ++opened; }}},
                    {{"safe", "Hide Identities", [&] { isOn = !isOn; }, [&] { return isOn; }}}}));
    stage.settle();
    EXPECT_NE(stage.dump().find("button: Menu"), std::string::npos);
    EXPECT_TRUE(gtk_widget_activate_action(stage.window(), "window.open", nullptr));
    EXPECT_TRUE(gtk_widget_activate_action(stage.window(), "window.safe", nullptr));
    EXPECT_EQ(opened, 1);
    EXPECT_TRUE(isOn);
}

TEST_F(MainFrameTest, AnEntryMayBeThereOnlyWhileAButtonIsSeen) {
    WindowStage stage(360, 720);
    int saved = 0;
    gtk_widget_set_visible(stage.frame.saveButton(), FALSE);
    stage.frame.setMenu(menuButton(stage.frame.window(), stage.guard,
                                   {{{.name = "save",
                                      .label = "Save Snapshot…",
                                      .action = [&] { ++saved; },
                                      .besides = stage.frame.saveButton()}}}));
    (void)gtk_widget_activate_action(stage.window(), "window.save", nullptr);
    EXPECT_EQ(saved, 0);
    gtk_widget_set_visible(stage.frame.saveButton(), TRUE);
    (void)gtk_widget_activate_action(stage.window(), "window.save", nullptr);
    EXPECT_EQ(saved, 1);
}

TEST_F(MainFrameTest, FitsAPhoneWithLargeTexts) {
    GtkSettings* settings = gtk_settings_get_default();
    gint usual = 0;
    g_object_get(settings, "gtk-xft-dpi", &usual, nullptr);
    constexpr int kTwice = 2 * 96 * 1024;
    g_object_set(settings, "gtk-xft-dpi", kTwice, nullptr);
    WindowStage stage(360, 720);
    stage.tick(terminal::display());
    stage.frame.remarks().setNote("End of the recording");
    stage.select(0);
    EXPECT_LE(gtk_widget_get_width(stage.window()), 360);
    g_object_set(settings, "gtk-xft-dpi", usual, nullptr);
}

TEST_F(MainFrameTest, ClosingTheWindowAsksTheProgramToEnd) {
    WindowStage stage(360, 720);
    gtk_window_close(stage.frame.window());
    stage.settle();
    EXPECT_EQ(stage.closings, 1);
}

} // namespace
} // namespace pallax::gtk
