#include "ui/gtk/PageStack.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

namespace pallax::gtk {
namespace {

/// A window with panes, over which the test opens pages.
class PageStackTest : public DisplayTest {
protected:
    void SetUp() override {
        DisplayTest::SetUp();
        if (!IsSkipped()) {
            stage = std::make_unique<WindowStage>(360, 720);
            stage->tick(Dictionary{{"RSRP", "-92.25 dBm"}});
            value = owned(gtk_button_new_with_label("a value"));
            graph = owned(gtk_label_new("a graph"));
        }
    }
    PageStack& pages() { return stage->frame.pages(); }
    void open(const Ref<GtkWidget>& page, const char* title) {
        pages().open(page.get(), title);
        stage->settle();
    }
    /// What is seen: the title of the page on top, or of the pane.
    std::string title() {
        const std::string dump = stage->dump();
        const std::size_t begin = dump.find("title: ");
        return dump.substr(begin, dump.find(" / ", begin) - begin);
    }
    GtkWidget* focus() { return gtk_window_get_focus(stage->frame.window()); }
    void pressKey(guint key) {
        const Ref<GListModel> controllers(gtk_widget_observe_controllers(stage->window()));
        gboolean isTaken = FALSE;
        for (guint index = 0; index < g_list_model_get_n_items(controllers.get()); ++index) {
            const Ref<GObject> each(G_OBJECT(g_list_model_get_item(controllers.get(), index)));
            if (isTaken == FALSE && GTK_IS_EVENT_CONTROLLER_KEY(each.get()) != FALSE) {
                g_signal_emit_by_name(each.get(), "key-pressed", key, 0U, GdkModifierType(),
                                      &isTaken);
            }
        }
        stage->settle();
    }

    std::unique_ptr<WindowStage> stage;
    Ref<GtkWidget> value;
    Ref<GtkWidget> graph;
};

TEST_F(PageStackTest, GoingBackShowsThePageBelowAndThenThePanes) {
    EXPECT_FALSE(pages().isOpen());
    open(value, "Value");
    open(graph, "Graph");
    EXPECT_EQ(title(), "title: Graph");
    EXPECT_TRUE(pages().shows(graph.get()));
    EXPECT_FALSE(pages().shows(value.get()));
    stage->press("Back");
    EXPECT_EQ(title(), "title: Value");
    EXPECT_TRUE(pages().shows(value.get()));
    pressKey(GDK_KEY_Escape);
    EXPECT_EQ(title(), "title: Pallax");
    EXPECT_FALSE(pages().isOpen());
    pages().close();
    EXPECT_EQ(title(), "title: Pallax") << "there is nothing to close";
}

TEST_F(PageStackTest, APageIsOpenOnce) {
    open(value, "Value");
    open(graph, "Graph");
    open(value, "Value again");
    EXPECT_EQ(title(), "title: Value again");
    pages().close();
    stage->settle();
    EXPECT_EQ(title(), "title: Graph");
    pages().close();
    stage->settle();
    EXPECT_EQ(title(), "title: Pallax");
}

TEST_F(PageStackTest, AllPagesCloseAtOnce) {
    open(value, "Value");
    open(graph, "Graph");
    pages().closeAll();
    stage->settle();
    EXPECT_EQ(title(), "title: Pallax");
    EXPECT_FALSE(pages().isOpen());
    EXPECT_EQ(gtk_widget_get_parent(value.get()), nullptr);
}

TEST_F(PageStackTest, WhoeverFillsPagesHearsThatOneIsSeenAgain) {
    std::vector<bool> uncovered;
    pages().onUncovered([&] { uncovered.push_back(pages().shows(value.get())); });
    open(value, "Value");
    open(graph, "Graph");
    EXPECT_TRUE(uncovered.empty());
    pages().close();
    EXPECT_EQ(uncovered, (std::vector<bool>{true}));
    pages().close();
    EXPECT_EQ(uncovered.size(), 1U) << "panes are no page";
}

TEST_F(PageStackTest, TheKeyboardIsWhereItWasBefore) {
    GtkWidget* row =
        gtk_widget_get_first_child(WindowStage::below(stage->table().widget(), GTK_TYPE_LIST_VIEW));
    gtk_widget_grab_focus(row);
    open(value, "Value");
    gtk_widget_grab_focus(value.get());
    open(graph, "Graph");
    EXPECT_NE(focus(), value.get());
    pages().close();
    stage->settle();
    EXPECT_EQ(focus(), value.get());
    pages().close();
    stage->settle();
    EXPECT_EQ(focus(), row);
}

TEST_F(PageStackTest, ThePageOnTopIsFilteredUntilItCloses) {
    std::string shown = "not filtered";
    pages().open(value.get(), "Value", [&](const std::string& text) { shown = text; });
    open(graph, "Graph");
    stage->frame.toggleSearch();
    stage->settle();
    EXPECT_EQ(stage->dump().find("field: "), std::string::npos) << "a graph has no rows";
    pages().close();
    stage->frame.toggleSearch();
    stage->settle();
    gtk_editable_set_text(GTK_EDITABLE(gtk_widget_get_ancestor(focus(), GTK_TYPE_EDITABLE)), "sim");
    EXPECT_EQ(shown, "sim");
    pages().close();
    EXPECT_EQ(shown, "");
}

} // namespace
} // namespace pallax::gtk
