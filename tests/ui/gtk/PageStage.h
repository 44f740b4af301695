#pragma once

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"
#include "tests/ui/pages/SampleTimeline.h"

#include <cstdint>
#include <string>
#include <vector>

namespace pallax::gtk {

/// Tests of a page with a table over a simulated drive.
class PageTest : public DisplayTest {
protected:
    static constexpr int kPhone = 360;

    void open(int width) {
        stage = std::make_unique<WindowStage>(width, width == kPhone ? 720 : 768);
        stage->tick(Dictionary{{"RSRP", "-92.25 dBm"}, {"Cells", Array{Dictionary{{"PCI", "7"}}}}});
    }
    void recordDrive() {
        drive.emplace();
        moment = {drive->timeline.get(), drive->timeline->packets()};
    }
    void show(GtkWidget* page, const char* title) {
        stage->frame.pages().open(page, title);
        settle();
    }
    void settle() {
        for (int time = 0; time < 3; ++time) {
            stage->settle();
        }
    }
    void TearDown() override {
        if (stage != nullptr) {
            stage->frame.pages().close();
            stage->settle();
        }
    }
    std::string dump() { return stage->dump(); }
    bool shows(const std::string& text) { return dump().find(text) != std::string::npos; }
    /// Chooses a row of the page's table.
    void activate(GtkWidget* page, guint row) {
        g_signal_emit_by_name(WindowStage::below(page, GTK_TYPE_LIST_VIEW), "activate", row);
        settle();
    }
    /// Types into the page's field. A search waits until nothing more is typed.
    GtkEditable* field(GtkWidget* page) {
        return GTK_EDITABLE(WindowStage::below(page, GTK_TYPE_EDITABLE));
    }
    void pressInField(GtkWidget* page, guint key) {
        GtkWidget* widget = GTK_WIDGET(field(page));
        const Ref<GListModel> controllers(gtk_widget_observe_controllers(widget));
        const Ref<GObject> keys(G_OBJECT(g_list_model_get_item(controllers.get(), 0)));
        gboolean isTaken = FALSE;
        g_signal_emit_by_name(keys.get(), "key-pressed", key, 0U, GdkModifierType(), &isTaken);
        settle();
    }

    std::unique_ptr<WindowStage> stage;
    std::optional<terminal::SampleTimeline> drive;
    Moment moment;
    std::vector<std::uint64_t> went;
};

} // namespace pallax::gtk
