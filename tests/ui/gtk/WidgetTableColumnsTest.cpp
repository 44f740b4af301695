#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

#include <chrono>
#include <string>

namespace pallax::gtk {
namespace {

/// A pane of a list as a table: see WidgetTableColumns.cpp.
class WidgetTableColumns : public DisplayTest {
protected:
    static PropertyList neighbours(const char* rsrp = "-98.25 dBm") {
        const auto cell = [](const char* pci, const char* level) {
            return Dictionary{{"RSRP", level}, {"Physical Cell ID", pci}};
        };
        return Dictionary{
            {"Neighbors", Array{cell("275", rsrp), cell("276", "-101.00 dBm")}},
            {"SIM Info", Dictionary{{"IMSI", "001010123456789"}}},
        };
    }
    void open(int width, int height) {
        stage = std::make_unique<WindowStage>(width, height);
        stage->toolkit.lists().partAt = [](const std::string& path) {
            return path == "/Neighbors/*/Physical Cell ID" ? EntryPart::Cell : EntryPart::None;
        };
        stage->tick(neighbours());
        stage->select(0);
    }

    std::unique_ptr<WindowStage> stage;
};

TEST_F(WidgetTableColumns, AButtonOfTheTitleBarShowsAListAsATableAndAsRowsAgain) {
    open(360, 720);
    const std::string rows = stage->dump();
    EXPECT_EQ(rows, R"(
button: Back
button: Show as Table
title: Neighbors / 
row: 0 (at 10) [go-next-symbolic]
row: 1 (at 10) [go-next-symbolic]
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
    stage->press("Show as Table");
    stage->settle();
    EXPECT_EQ(stage->dump(), R"(
button: Back
button: Show as Rows
title: Neighbors / 
columns: Physical Cell ID (right) | RSRP dBm (right)
cells (cursor) (focus): 275 | -98.25
cells: 276 | -101.00
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
    stage->press("Show as Rows");
    EXPECT_EQ(stage->dump(), rows);
}

TEST_F(WidgetTableColumns, ItIsBesideTheRootPaneWhereThereIsRoom) {
    open(1024, 768);
    stage->press("Show as Table");
    stage->settle();
    EXPECT_EQ(stage->dump(), R"(
button: Back
button: Show as Rows
title: Neighbors / 
columns: Physical Cell ID (right) | RSRP dBm (right)
cells (cursor) (focus): 275 | -98.25
cells: 276 | -101.00
row: Neighbors (at 10) 2 [go-next-symbolic], open
row: SIM Info (at 10) [go-next-symbolic]
text: Updated 2023-11-14 at 22:13:20
button: Save
)");
}

TEST_F(WidgetTableColumns, OtherPanesHaveNoSuchButton) {
    open(360, 720);
    stage->press("Back");
    EXPECT_EQ(stage->dump().find("Show as"), std::string::npos);
    stage->frame.switchLists();
    stage->settle();
    EXPECT_NE(stage->dump().find("text: Nothing to show as a table: choose a list."),
              std::string::npos)
        << stage->dump();
}

TEST_F(WidgetTableColumns, ChangesAreMarkedAtTheNextTick) {
    open(360, 720);
    stage->press("Show as Table");
    stage->tick(neighbours("-97.00 dBm"));
    EXPECT_NE(stage->dump().find("cells (cursor) (focus): 275 | -97.00 (changed)\n"),
              std::string::npos)
        << stage->dump();
}

TEST_F(WidgetTableColumns, ARowOpensItsEntry) {
    open(360, 720);
    stage->press("Show as Table");
    GtkWidget* list = WindowStage::found(stage->table().widget(), [](GtkWidget* widget) {
        return GTK_IS_LIST_VIEW(widget) != FALSE && gtk_widget_get_mapped(widget) != FALSE;
    });
    g_signal_emit_by_name(list, "activate", 1U);
    stage->settle();
    EXPECT_EQ(stage->depth(), 3U);
    EXPECT_NE(stage->dump().find("row: Physical Cell ID (at 10) | 276 (flush right)"),
              std::string::npos)
        << stage->dump();
}

TEST_F(WidgetTableColumns, TheFilterIsThatOfTheTable) {
    open(360, 720);
    stage->press("Show as Table");
    stage->table().setFilter("101");
    stage->settle();
    EXPECT_EQ(stage->dump().find("cells (cursor): 275"), std::string::npos);
    EXPECT_NE(stage->dump().find(": 276 | -101.00"), std::string::npos);
}

TEST_F(WidgetTableColumns, AgesAreAColumnThatIsShownWithAllColumns) {
    open(360, 720);
    stage->toolkit.lists().ageAt = [](const std::string& path) {
        return path.starts_with("/Neighbors/1/") ? std::optional(std::chrono::seconds(9))
                                                 : std::nullopt;
    };
    stage->press("Show as Table");
    EXPECT_EQ(stage->dump().find("| age"), std::string::npos);
    stage->settle();
    GtkWidget* strip = WindowStage::found(stage->table().widget(), [](GtkWidget* widget) {
        return gtk_widget_has_css_class(widget, "pallax-headings") != FALSE;
    });
    const Ref<GListModel> controllers(gtk_widget_observe_controllers(gtk_widget_get_parent(strip)));
    const Ref<GObject> keys(G_OBJECT(g_list_model_get_item(controllers.get(), 0)));
    gboolean isTaken = FALSE;
    g_signal_emit_by_name(keys.get(), "key-pressed", GDK_KEY_X, 0U, GdkModifierType(), &isTaken);
    stage->settle();
    EXPECT_NE(stage->dump().find("276 | -101.00 | 9 s"), std::string::npos) << stage->dump();
}

TEST_F(WidgetTableColumns, ARowIsSelectedWhateverTheLook) {
    open(360, 720);
    stage->table().select(1);
    stage->settle();
    GtkWidget* focus = gtk_window_get_focus(stage->frame.window());
    ASSERT_NE(focus, nullptr);
    EXPECT_EQ(stage->table().pane().cursorRow(), 1U);
    EXPECT_STREQ(G_OBJECT_TYPE_NAME(focus), "GtkListItemWidget");
    stage->press("Show as Table");
    stage->settle();
    EXPECT_NE(stage->dump().find("cells (cursor) (focus): 276"), std::string::npos)
        << "the cursor stays on its entry" << stage->dump();
    stage->table().setFilter("275");
    stage->table().select(1);
    stage->settle();
    EXPECT_NE(stage->dump().find("cells (cursor) (focus): 276"), std::string::npos)
        << "the filter hid it" << stage->dump();
}

} // namespace
} // namespace pallax::gtk
