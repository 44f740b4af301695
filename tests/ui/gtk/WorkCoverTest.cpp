#include "ui/gtk/WorkCover.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"
#include "tests/ui/terminal/StageData.h"

namespace pallax::gtk {
namespace {

class WorkCoverTest : public DisplayTest {};

/// A window with what is tested.
struct WorkCoverStage {
    WorkCoverStage() {
        stage.tick(terminal::display());
        stage.frame.onKey([this](guint, GdkModifierType) { return ++keys > 0; });
        panes = stage.dump();
    }
    void work(const std::string& words) {
        stage.frame.showWork(words, [this] { ++stops; });
        stage.settle();
    }
    /// Presses a key; whether the frame keeps it from all widgets.
    bool press(guint key) {
        gboolean isTaken = FALSE;
        GListModel* controllers = gtk_widget_observe_controllers(stage.window());
        for (guint index = 0; index < g_list_model_get_n_items(controllers); ++index) {
            const Ref<GObject> each(G_OBJECT(g_list_model_get_item(controllers, index)));
            if (isTaken == FALSE && GTK_IS_EVENT_CONTROLLER_KEY(each.get()) != FALSE &&
                gtk_event_controller_get_propagation_phase(GTK_EVENT_CONTROLLER(each.get())) ==
                    GTK_PHASE_CAPTURE) {
                g_signal_emit_by_name(each.get(), "key-pressed", key, 0U,
                                      static_cast<GdkModifierType>(0), &isTaken);
            }
        }
        g_object_unref(controllers);
        return isTaken != FALSE;
    }

    WindowStage stage{360, 720};
    std::string panes;
    int stops = 0;
    int keys = 0;
};

TEST_F(WorkCoverTest, TellsOfTheWorkInPlaceOfEverything) {
    WorkCoverStage tested;
    tested.work("Searching: 10 %. Esc stops.");
    EXPECT_EQ(tested.stage.dump(), R"(
text: Pallax
spinner: turns
text: Searching: 10 %. Esc stops.
button: Cancel (focus)
)");
    tested.work("Searching: 20 %. Esc stops.");
    EXPECT_NE(tested.stage.dump().find("Searching: 20 %"), std::string::npos);
    EXPECT_EQ(tested.stage.dump().find("Searching: 10 %"), std::string::npos);
    tested.stage.frame.endWork();
    tested.stage.settle();
    EXPECT_EQ(tested.stage.dump(), tested.panes);
    tested.stage.frame.endWork(); // there is none
    EXPECT_EQ(tested.stops, 0);
}

TEST_F(WorkCoverTest, CancelEscapeAndClosingTheWindowStopIt) {
    WorkCoverStage tested;
    tested.work("Working.");
    tested.stage.press("Cancel");
    EXPECT_EQ(tested.stops, 1);
    EXPECT_TRUE(tested.press(GDK_KEY_Escape));
    EXPECT_EQ(tested.stops, 2);
    gboolean isHandled = FALSE;
    g_signal_emit_by_name(tested.stage.window(), "close-request", &isHandled);
    EXPECT_EQ(tested.stops, 3);
    tested.stage.queue.runReady();
    EXPECT_EQ(tested.stage.closings, 1);
    tested.stage.frame.endWork();
}

TEST_F(WorkCoverTest, NoOtherKeyDoesAnything) {
    WorkCoverStage tested;
    tested.work("Working.");
    for (const auto key : std::initializer_list<guint>{GDK_KEY_o, GDK_KEY_slash, GDK_KEY_comma,
                                                       GDK_KEY_F10, GDK_KEY_n}) {
        EXPECT_TRUE(tested.press(key));
    }
    for (const auto key :
         std::initializer_list<guint>{GDK_KEY_Return, GDK_KEY_space, GDK_KEY_Tab}) {
        EXPECT_FALSE(tested.press(key)) << "its button gets it";
    }
    EXPECT_EQ(tested.keys, 0);
    EXPECT_EQ(tested.stops, 0);
    tested.stage.frame.endWork();
    EXPECT_TRUE(tested.press(GDK_KEY_n));
    EXPECT_EQ(tested.keys, 1);
}

TEST_F(WorkCoverTest, AnOpenPageIsThereAgainAfterwards) {
    WorkCoverStage tested;
    const Ref<GtkWidget> label = owned(gtk_label_new("a value"));
    tested.stage.frame.pages().open(label.get(), "RSRP");
    tested.stage.settle();
    const std::string page = tested.stage.dump();
    tested.work("Working.");
    tested.stage.frame.endWork();
    tested.stage.settle();
    EXPECT_EQ(tested.stage.dump(), page);
    tested.stage.frame.pages().close();
}

} // namespace
} // namespace pallax::gtk
