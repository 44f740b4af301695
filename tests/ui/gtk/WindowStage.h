#pragma once

#include "app/PallaxPaneController.h"
#include "app/PallaxSaveViewController.h"
#include "app/tree/PallaxModelNode.h"
#include "platform/ui/Window.h"
#include "tests/doubles/FakeFileSystem.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/SteppedQueue.h"
#include "tests/ui/gtk/WindowDump.h"
#include "ui/gtk/MainFrame.h"
#include "ui/gtk/WidgetTable.h"
#include "ui/gtk/WidgetToolkit.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax::gtk {

/// A window with the application's own panes and snapshot screen, which shows a display that the
/// test sets.
class WindowStage final : public PaneApplication, public ui::NavigationDelegate {
public:
    WindowStage(int width, int height)
        : frame(nullptr, guard, {[this] { ++closings; }}), toolkit(frame, guard),
          _window(toolkit.makeWindow({})) {
        gtk_window_set_default_size(frame.window(), width, height);
        auto root = std::make_shared<PallaxPaneController>(toolkit, *this, nullptr, "/");
        root->setStatus("Connecting", true);
        _stack = toolkit.makeNavigationStack(std::move(root));
        _stack->setDelegate(this);
        _window->setRoot(*_stack);
        _window->addView(*_stack);
        _window->makeKeyAndVisible();
        settle();
    }

    doubles::SteppedQueue queue;
    Guard guard{queue};
    MainFrame frame;
    WidgetToolkit toolkit;
    int closings = 0;
    bool savingAllowed = true;
    doubles::FakeFileSystem files;
    doubles::ManualClock clock;
    PropertyList saveHistory;
    ReadingAges ages; ///< of the panes that are opened later

    /// Shows new data, as the application does.
    void tick(const PropertyList& display) {
        give(display);
        settle();
    }
    /// The same, without waiting for a frame.
    void give(const PropertyList& display) {
        PathDictionary paths;
        const NodeRef root = PallaxModelNode::makeTreeFromObject(display, paths);
        _isConnected = root != nullptr;
        const auto panes = _stack->screens();
        for (std::size_t index = 0; index < panes.size(); ++index) {
            auto& pane = dynamic_cast<PallaxPaneController&>(*panes[index]);
            const auto found = paths.find(pane.path());
            if (index > 0 && found == paths.end()) {
                _stack->popTo(index - 1, true);
                break;
            }
            pane.reloadWithNode(index == 0 ? root : found->second);
        }
        showStatus(*_stack->screens().back());
    }

    /// Lets the toolkit draw, and everything that follows from it happen: some frames.
    void settle() {
        constexpr int kFrames = 3;
        GdkFrameClock* frames = gtk_widget_get_frame_clock(window());
        int painted = 0;
        const gulong handler = g_signal_connect(
            frames, "after-paint",
            G_CALLBACK(+[](GdkFrameClock* /*clock*/, int* count) { ++*count; }), &painted);
        while (painted < kFrames) {
            gdk_frame_clock_request_phase(frames, GDK_FRAME_CLOCK_PHASE_PAINT);
            (void)g_main_context_iteration(nullptr, TRUE);
            queue.runReady();
        }
        g_signal_handler_disconnect(frames, handler);
    }
    void resize(int width, int height) {
        gtk_window_set_default_size(frame.window(), width, height);
        settle();
        settle();
    }

    std::string dump() { return windowDump(window()); }
    GtkWidget* window() const { return GTK_WIDGET(frame.window()); }
    WidgetTable& table(std::size_t pane) {
        return widgetTable(_stack->screens().at(pane)->table());
    }
    WidgetTable& table() { return table(depth() - 1); }
    std::size_t depth() const { return _stack->screens().size(); }
    /// Selects a row of the topmost pane, as a touch does.
    void select(guint row) { select(row, depth() - 1); }
    void select(guint row, std::size_t pane) {
        g_signal_emit_by_name(below(table(pane).widget(), GTK_TYPE_LIST_VIEW), "activate", row);
        settle();
    }
    /// Presses the button with this label or tooltip.
    void press(const std::string& name) {
        GtkWidget* button = found(window(), [&](GtkWidget* widget) {
            const char* label =
                GTK_IS_BUTTON(widget) ? gtk_button_get_label(GTK_BUTTON(widget)) : nullptr;
            const char* tooltip =
                GTK_IS_BUTTON(widget) ? gtk_widget_get_tooltip_text(widget) : nullptr;
            return gtk_widget_get_mapped(widget) != FALSE &&
                   ((label != nullptr && label == name) || (tooltip != nullptr && tooltip == name));
        });
        ASSERT_NE(button, nullptr) << name;
        g_signal_emit_by_name(button, "clicked");
        settle();
    }
    static GtkWidget* below(GtkWidget* widget, GType type) {
        return found(widget, [type](GtkWidget* each) {
            return g_type_is_a(G_OBJECT_TYPE(each), type) != FALSE;
        });
    }
    static GtkWidget* found(GtkWidget* widget, const std::function<bool(GtkWidget*)>& matches) {
        if (matches(widget)) {
            return widget;
        }
        for (GtkWidget* child = gtk_widget_get_first_child(widget); child != nullptr;
             child = gtk_widget_get_next_sibling(child)) {
            if (GtkWidget* match = found(child, matches)) {
                return match;
            }
        }
        return nullptr;
    }

    const std::shared_ptr<PallaxSaveViewController>& saveScreen() const { return _saveScreen; }

    // Requests of the panes to the application.
    bool allowSaveButton() const override { return savingAllowed; }
    void showSaveView() override {
        _saveScreen = std::make_shared<PallaxSaveViewController>(
            PallaxSaveViewController::Surroundings{toolkit, files, clock, clock, queue,
                                                   "/snapshots",
                                                   [this] {
                                                       _stack->dismissModal(true);
                                                       _saveScreen = nullptr;
                                                   },
                                                   [] {}},
            saveHistory);
        _stack->presentModal(_saveScreen, true);
    }
    ReadingAges readingAges() override { return ages; }
    ui::NavigationStack* navigationController() override { return _stack.get(); }
    void navigationControllerWillShow(ui::NavigationStack& /*stack*/, ui::TableScreen& screen,
                                      bool /*animated*/) override {
        showStatus(screen);
    }

private:
    void showStatus(ui::TableScreen& screen) {
        dynamic_cast<PallaxPaneController&>(screen).setStatus(
            _isConnected ? "Updated 2023-11-14 at 22:13:20" : "Connecting...", !_isConnected);
    }

    bool _isConnected = false;
    std::unique_ptr<ui::NavigationStack> _stack;
    std::unique_ptr<ui::Window> _window; // destroyed before the stack
    std::shared_ptr<PallaxSaveViewController> _saveScreen;
};

} // namespace pallax::gtk
