#pragma once

#include "platform/ui/Geometry.h"
#include "platform/ui/Views.h"
#include "ui/gtk/FilterBar.h"
#include "ui/gtk/Messages.h"
#include "ui/gtk/PageStack.h"
#include "ui/gtk/PangoMetrics.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Remarks.h"
#include "ui/gtk/Signals.h"
#include "ui/gtk/WidgetNavigation.h"
#include "ui/gtk/WorkCover.h"

#include <adwaita.h>
#include <functional>
#include <string>
#include <vector>

namespace pallax::gtk {

/// The window around the panes: title bar, toolbar, the snapshot screen over the panes, alerts, and
/// the page that tells why the program has ended.
class MainFrame {
public:
    struct Actions {
        std::function<void()> closed; ///< the user has closed the window
    };

    /// `application` may be null. The actions run outside the toolkit's own frames.
    MainFrame(GtkApplication* application, const Guard& guard, Actions actions);
    ~MainFrame();
    MainFrame(const MainFrame&) = delete;
    MainFrame& operator=(const MainFrame&) = delete;

    PangoMetrics& metrics() { return _metrics; }
    GtkWindow* window() const { return GTK_WINDOW(_window.get()); }
    /// In points.
    ui::Rect bounds() const;

    /// The stack that is shown; null: none.
    void setStack(WidgetNavigation* stack);
    /// What the frame calls for: the topmost pane has changed, or its title or toolbar.
    void refresh();
    void modalChanged();
    /// With a token of the desktop ("": none), which lets the window come to the front.
    void present(const std::string& token = "");
    void hide();
    /// Shows one after the other.
    void showAlert(const ui::Alert& alert);

    /// Shows an event that has just happened, for some seconds or until the next one.
    void setMessage(const std::string& text) { _messages.show(text); }
    Remarks& remarks() { return _remarks; }
    void setOrigin(const std::string& technology, const std::string& source);
    /// The values are from before this time; "": they are current.
    void setOldValues(const std::string& time);
    /// In place of everything: nothing comes any more, because of what the sentence says.
    void showEnded(const std::string& sentence);

    /// At the right of the title bar.
    void setMenu(GtkWidget* button);
    /// What stands beside the root pane while no other is open, or on its own.
    void setDetail(GtkWidget* widget, std::string title);
    /// On a screen with room for one pane, the detail is shown over the root pane, or no longer.
    void toggleDetail();
    /// The panes of another instant, in place of the live ones; null: the live ones.
    void setHeldStack(WidgetNavigation* stack);
    /// The panes that are shown.
    WidgetNavigation* shownStack() const { return _stack; }
    /// The panes whose application lives.
    WidgetNavigation* liveStack() const { return _live; }
    /// The toolbar's button; seen where a snapshot can be saved.
    GtkWidget* saveButton() const { return GTK_WIDGET(_save); }
    void save() { _saveAction(); }
    /// The keyboard goes to the panes.
    void focusPanes() { gtk_widget_child_focus(GTK_WIDGET(_panes), GTK_DIR_TAB_FORWARD); }
    /// Below the panes.
    void addBar(GtkWidget* bar);
    /// Keys that go to the frame when nothing else takes them; true: taken.
    void onKey(std::function<bool(guint key, GdkModifierType state)> action) {
        _key = std::move(action);
    }
    /// The field that filters what is seen: the topmost pane, or the page.
    void toggleSearch();
    /// Closes that of the panes, so that the topmost one shows all rows.
    void closeSearch() { _filter.close(); }
    /// Shows lists as tables, or as rows; says so where there is no list.
    void switchLists();
    /// A row with a value was selected.
    void onLeaf(std::function<void(const std::string& path, const std::string& text)> action) {
        _leaf = std::move(action);
    }
    void leafSelected(const std::string& path, const std::string& text) { _leaf(path, text); }
    /// The pages over the panes.
    PageStack& pages() { return _pages; }
    const PageStack& pages() const { return _pages; }
    /// Long work, in place of everything: what is going on, and a button that stops it. No other
    /// key or button does anything meanwhile. Words again replace the latest.
    void showWork(const std::string& words, std::function<void()> stop);
    void endWork();

private:
    void build();
    void listen();
    GtkWidget* buildToolbar();
    void adopt(WidgetNavigation* stack);
    void showToolbarItems(const ui::BarItems& items);
    void reloadTables();
    void showListButton();
    void back();
    gboolean handleKey(guint key, guint code, GdkModifierType state);

    Guard _guard;
    Actions _actions;
    Ref<GtkWidget> _window;
    PangoMetrics _metrics;
    WidgetNavigation* _stack = nullptr; ///< that is shown: the live one, or that of an instant
    WidgetNavigation* _live = nullptr;
    std::function<bool(guint, GdkModifierType)> _key = [](guint, GdkModifierType) { return false; };
    Messages _messages;
    // The window owns what follows.
    GtkStack* _layers;
    PageStack _pages;
    AdwHeaderBar* _header;
    AdwWindowTitle* _title;
    GtkButton* _back;
    GtkLabel* _oldValues;
    AdwBin* _panes;
    FilterBar _filter; ///< of the topmost pane
    GtkButton* _lists; ///< shows a list as a table, or as rows
    GtkBox* _bars;     ///< below the panes
    GtkBox* _toolbar;
    GtkSpinner* _spinner;
    GtkLabel* _status;
    GtkButton* _save;
    GtkWidget* _modal = nullptr;
    WorkCover _work;
    std::function<void(const std::string&, const std::string&)> _leaf =
        [](const std::string& /*path*/, const std::string& /*text*/) {};
    Ref<GtkWidget> _detail; ///< beside the root pane
    std::string _detailTitle;
    std::function<void()> _saveAction = [] {};
    Remarks _remarks;
    std::vector<std::pair<gpointer, gulong>> _handlers;
};

} // namespace pallax::gtk
