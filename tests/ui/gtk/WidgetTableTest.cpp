#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"
#include "ui/gtk/ShownText.h"

#include <gdk/x11/gdkx.h>
#include <string>

namespace pallax::gtk {
namespace {

class WidgetTableRows : public DisplayTest {
protected:
    /// "Row 0" to the last, with values.
    static Dictionary rows(int count, const std::string& value = "1") {
        Dictionary made;
        for (int row = 0; row < count; ++row) {
            made.set("Row " + std::to_string(row), value.c_str());
        }
        return made;
    }
    static GtkAdjustment* place(WindowStage& stage) {
        return gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(
            WindowStage::below(stage.table().widget(), GTK_TYPE_SCROLLED_WINDOW)));
    }
    /// The sideways place of the first row.
    static GtkAdjustment* sideways(WindowStage& stage) {
        GtkWidget* list = WindowStage::below(stage.table().widget(), GTK_TYPE_LIST_VIEW);
        return gtk_scrolled_window_get_hadjustment(
            GTK_SCROLLED_WINDOW(WindowStage::below(list, GTK_TYPE_SCROLLED_WINDOW)));
    }
    static GtkWidget* rowWidget(WindowStage& stage, int index) {
        GtkWidget* row = gtk_widget_get_first_child(
            WindowStage::below(stage.table().widget(), GTK_TYPE_LIST_VIEW));
        for (; index > 0; --index) {
            row = gtk_widget_get_next_sibling(row);
        }
        return row;
    }
    static std::string nameOf(GtkWidget* row) {
        return gtk_label_get_text(GTK_LABEL(WindowStage::found(row, [](GtkWidget* widget) {
            return GTK_IS_LABEL(widget) && *gtk_label_get_text(GTK_LABEL(widget)) != '\0';
        })));
    }
};

TEST_F(WidgetTableRows, AMinimizedWindowIsFilledWhenItIsSeenAgain) {
    WindowStage stage(360, 640);
    stage.tick(rows(3, "before"));
    GdkSurface* surface = gtk_native_get_surface(GTK_NATIVE(stage.window()));
    Display* server = gdk_x11_display_get_xdisplay(gdk_display_get_default());
    const auto awaitSeen = [&](bool isWanted) {
        while (isSeen(stage.table().widget()) != isWanted) {
            (void)g_main_context_iteration(nullptr, TRUE);
        }
    };
    XUnmapWindow(server, gdk_x11_surface_get_xid(surface)); // as a window manager does
    awaitSeen(false);
    stage.give(rows(3, "after"));
    EXPECT_NE(stage.dump().find("| before"), std::string::npos) << stage.dump();
    EXPECT_EQ(stage.dump().find("| after"), std::string::npos) << stage.dump();

    XMapWindow(server, gdk_x11_surface_get_xid(surface));
    awaitSeen(true);
    EXPECT_NE(stage.dump().find("| after"), std::string::npos) << stage.dump();
    EXPECT_EQ(stage.dump().find("| before"), std::string::npos) << stage.dump();
}

TEST_F(WidgetTableRows, ThePlaceInTheListStaysAcrossTicks) {
    WindowStage stage(360, 400);
    stage.tick(rows(50));
    gtk_adjustment_set_value(place(stage), 600);
    stage.settle();
    stage.tick(rows(50, "2"));
    EXPECT_EQ(gtk_adjustment_get_value(place(stage)), 600);
    EXPECT_NE(stage.dump().find("Row 13 (at 10) | 2 (flush right)"), std::string::npos)
        << stage.dump();
}

TEST_F(WidgetTableRows, RowsThatComeIntoViewShowTheLatestValues) {
    WindowStage stage(360, 400);
    stage.tick(rows(50));
    stage.tick(rows(50, "2"));
    gtk_adjustment_set_value(place(stage), 500);
    stage.settle();
    EXPECT_EQ(stage.dump().find("| 1 ("), std::string::npos) << stage.dump();
    EXPECT_NE(stage.dump().find("| 2 ("), std::string::npos);
}

TEST_F(WidgetTableRows, ASidewaysOffsetStaysWithItsRowAcrossTicks) {
    WindowStage stage(360, 400);
    const std::string value(60, 'w');
    stage.tick(Dictionary{{"Name", value.c_str()}});
    gtk_adjustment_set_value(sideways(stage), 80);
    stage.tick(Dictionary{{"Name", value.c_str()}});
    EXPECT_NE(stage.dump().find("(50 behind), scrolled by 80"), std::string::npos) << stage.dump();
    stage.tick(Dictionary{{"New", "1"}, {"Name", value.c_str()}});
    EXPECT_NE(stage.dump().find("row: New (at 10) | 1 (flush right)\n"), std::string::npos);
    EXPECT_NE(stage.dump().find("(50 behind), scrolled by 80"), std::string::npos) << stage.dump();
}

TEST_F(WidgetTableRows, TheFocusStaysOnItsRowWhenAnotherComesAboveIt) {
    WindowStage stage(360, 400);
    stage.tick(Dictionary{{"A", "1"}, {"B", "1"}});
    gtk_widget_grab_focus(rowWidget(stage, 1));
    stage.tick(Dictionary{{"New", "1"}, {"A", "1"}, {"B", "1"}});
    GtkWidget* focus = gtk_window_get_focus(stage.frame.window());
    ASSERT_NE(focus, nullptr);
    EXPECT_EQ(nameOf(focus), "B");
}

TEST_F(WidgetTableRows, TheCursorIsOnTheRowWithTheKeyboardOrThatWasSelectedLast) {
    WindowStage stage(360, 400);
    stage.tick(Dictionary{{"A", "1"}, {"B", "1"}, {"C", "1"}});
    EXPECT_EQ(stage.table().cursorRow(), 0U);
    gtk_widget_grab_focus(rowWidget(stage, 1));
    EXPECT_EQ(stage.table().cursorRow(), 1U);
    stage.select(2);
    gtk_window_set_focus(stage.frame.window(), nullptr);
    EXPECT_EQ(stage.table().cursorRow(), 2U);
    stage.table().select(0);
    EXPECT_EQ(stage.table().cursorRow(), 0U);
}

TEST_F(WidgetTableRows, TellsTheValueUnderTheKeyboard) {
    WindowStage stage(360, 400);
    stage.tick(Dictionary{{"A", "1"}, {"Cell", Dictionary{{"RSRP", "-94 dBm"}}}});
    gtk_window_set_focus(stage.frame.window(), nullptr);
    EXPECT_EQ(stage.frame.shownStack()->focusedValue(), std::nullopt);
    gtk_widget_grab_focus(rowWidget(stage, 0));
    EXPECT_EQ(stage.frame.shownStack()->focusedValue(), "/A");
    gtk_widget_grab_focus(rowWidget(stage, 1));
    EXPECT_EQ(stage.frame.shownStack()->focusedValue(), std::nullopt) << "a pane";
    stage.select(1);
    gtk_widget_grab_focus(rowWidget(stage, 0));
    EXPECT_EQ(stage.frame.shownStack()->focusedValue(), "/Cell/RSRP");
}

TEST_F(WidgetTableRows, WhatHasChangedIsMarkedForOneTick) {
    WindowStage stage(360, 400);
    stage.tick(Dictionary{{"A", "1"}});
    stage.tick(Dictionary{{"A", "2"}});
    const auto isMarked = [&] {
        return WindowStage::found(rowWidget(stage, 0), [](GtkWidget* widget) {
                   return gtk_widget_has_css_class(widget, "pallax-changed") != FALSE;
               }) != nullptr;
    };
    EXPECT_TRUE(isMarked());
    stage.tick(Dictionary{{"A", "2"}});
    EXPECT_FALSE(isMarked());
}

TEST_F(WidgetTableRows, ARowThatStaysAsItIsIsLeftAlone) {
    WindowStage stage(360, 400);
    stage.tick(Dictionary{{"A", "1"}});
    const auto name = [&] {
        return GTK_LABEL(WindowStage::found(rowWidget(stage, 0), [](GtkWidget* widget) {
            return GTK_IS_LABEL(widget) && *gtk_label_get_text(GTK_LABEL(widget)) != '\0';
        }));
    };
    gtk_label_set_text(name(), "painted over");
    stage.tick(Dictionary{{"A", "1"}});
    EXPECT_STREQ(gtk_label_get_text(name()), "painted over");
    stage.tick(Dictionary{{"A", "2"}});
    EXPECT_STREQ(gtk_label_get_text(name()), "A");
}

TEST_F(WidgetTableRows, ANameThatIsCutIsShownInFullWhenThereIsRoom) {
    const Dictionary display{
        {"Connected mode LTE Intra-frequency Measurement", Dictionary{{"A", "1"}}}};
    WindowStage stage(360, 400);
    stage.tick(display);
    const auto name = [&] {
        return GTK_LABEL(WindowStage::found(rowWidget(stage, 0), [](GtkWidget* widget) {
            return GTK_IS_LABEL(widget) && *gtk_label_get_text(GTK_LABEL(widget)) != '\0';
        }));
    };
    const auto isCut = [&] {
        return pango_layout_is_ellipsized(gtk_label_get_layout(name())) != FALSE;
    };
    EXPECT_TRUE(isCut());
    stage.resize(1024, 400);
    EXPECT_FALSE(isCut());
    EXPECT_EQ(gtk_widget_get_tooltip_text(GTK_WIDGET(name())), nullptr);
    stage.resize(360, 400);
    EXPECT_TRUE(isCut());
    EXPECT_EQ(gtk_adjustment_get_upper(sideways(stage)),
              gtk_adjustment_get_page_size(sideways(stage)))
        << "what ends in dots does not scroll";
}

TEST_F(WidgetTableRows, ScreenReadersHearNameAndValue) {
    WindowStage stage(360, 400);
    stage.tick(Dictionary{{"RSRP", "1"}, {"List", Array{Dictionary{}, Dictionary{}}}});
    stage.tick(Dictionary{{"RSRP", "-94.75 dBm"}, {"List", Array{Dictionary{}, Dictionary{}}}});
    const auto hears = [&](int row, const char* words) {
        char* fault = gtk_test_accessible_check_property(
            GTK_ACCESSIBLE(gtk_widget_get_first_child(rowWidget(stage, row))),
            GTK_ACCESSIBLE_PROPERTY_LABEL, words);
        EXPECT_EQ(fault, nullptr) << fault;
        g_free(fault);
    };
    hears(0, "RSRP: -94.75 dBm, changed");
    hears(1, "List, 2");
}

TEST_F(WidgetTableRows, OnlyRowsInViewAreAskedFor) {
    WindowStage stage(360, 400);
    stage.tick(rows(1000));
    // A row that is not asked for at the tick of a change does not show it later.
    stage.tick(rows(1000, "2"));
    EXPECT_TRUE(stage.table().pane().row(2).hasChanged);
    int asked = 0;
    for (std::size_t row = 0; row < 1000; ++row) {
        asked += stage.table().pane().row(row).changedAt ? 1 : 0;
    }
    EXPECT_LT(asked, 300);
}

} // namespace
} // namespace pallax::gtk
