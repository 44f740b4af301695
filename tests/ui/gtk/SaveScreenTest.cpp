#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"
#include "tests/ui/terminal/StageData.h"

namespace pallax::gtk {
namespace {

using terminal::display;
using terminal::snapshotItems;

class SaveScreen : public DisplayTest {};

/// A stage with the screen open.
class OpenStage {
public:
    OpenStage() {
        stage.tick(display());
        stage.saveHistory = snapshotItems();
        stage.press("Save");
    }
    WindowStage stage{360, 720};
};

const char* const kPane = R"(
title: Pallax / 
row: Serving Cell Measurements (at 10) [go-next-symbolic]
row: Measured Neighbor Cells (at 10) 3 [go-next-symbolic]
row: Empty List (at 10) [go-next-symbolic]
row: SIM Info (at 10) [go-next-symbolic]
row: Operator (at 10) | Example (flush right)
text: Updated 2023-11-14 at 22:13:20
button: Save
)";

void type(WindowStage& stage, const char* text) {
    gtk_editable_set_text(GTK_EDITABLE(WindowStage::below(stage.window(), GTK_TYPE_ENTRY)), text);
}

TEST_F(SaveScreen, ListsWhatIsSavedWithCheckMarks) {
    OpenStage open;
    EXPECT_EQ(open.stage.dump(), R"(
button: Cancel
title: Save snapshot / 
button: Save
row: Snapshot (2023-11-14 22:13:14 +0000) (at 10) [object-select-symbolic]
row: Snapshot (2023-11-14 22:13:16 +0000) (at 10) [object-select-symbolic]
row: DLF binary (48213 bytes) (at 10) [object-select-symbolic]
text: Description
field: ""
)");
}

TEST_F(SaveScreen, SaveWritesTheFileWithTheDescriptionAndCloses) {
    OpenStage open;
    type(open.stage, "tunnel <b>entrance</b>");
    open.stage.press("Save");
    EXPECT_EQ(open.stage.dump(), kPane);
    ASSERT_EQ(open.stage.files.files.size(), 1U);
    const auto root = open.stage.files.files.begin()->second.dictionary();
    EXPECT_EQ(*root->find("Description"), PropertyList("tunnel <b>entrance</b>"));
}

TEST_F(SaveScreen, CancelWritesNothing) {
    OpenStage open;
    open.stage.press("Cancel");
    EXPECT_EQ(open.stage.dump(), kPane);
    EXPECT_TRUE(open.stage.files.files.empty());
}

TEST_F(SaveScreen, AFailureIsAnAlertOverThePane) {
    OpenStage open;
    open.stage.files.failWrite = true;
    open.stage.press("Save");
    EXPECT_EQ(open.stage.dump(), kPane);
    GtkWidget* alert = nullptr;
    const Ref<GListModel> windows(shared(gtk_window_get_toplevels()));
    for (guint index = 0; index < g_list_model_get_n_items(windows.get()); ++index) {
        const Ref<GtkWidget> each(GTK_WIDGET(g_list_model_get_item(windows.get(), index)));
        if (ADW_IS_MESSAGE_DIALOG(each.get()) && gtk_widget_get_mapped(each.get()) != FALSE) {
            alert = each.get();
        }
    }
    ASSERT_NE(alert, nullptr);
    EXPECT_EQ(windowDump(alert), R"(
text: File Error
text: Unable to write file to disk
button: Close (focus)
)");
    gtk_window_destroy(GTK_WINDOW(alert));
}

TEST_F(SaveScreen, TheFieldHasTheFocusUntilReturnOrATouch) {
    OpenStage open;
    GtkWidget* entry = WindowStage::below(open.stage.window(), GTK_TYPE_ENTRY);
    const auto isEdited = [&] {
        GtkWidget* focus = gtk_window_get_focus(open.stage.frame.window());
        return focus != nullptr && gtk_widget_is_ancestor(focus, entry) != FALSE;
    };
    EXPECT_TRUE(isEdited());
    g_signal_emit_by_name(entry, "activate");
    EXPECT_FALSE(isEdited());
    gtk_widget_grab_focus(entry);
    EXPECT_TRUE(isEdited());
    open.stage.saveScreen()->backgroundTouched();
    EXPECT_FALSE(isEdited());
}

} // namespace
} // namespace pallax::gtk
