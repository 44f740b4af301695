#pragma once

#include "platform/ui/Geometry.h"
#include "platform/ui/Views.h"
#include "ui/gtk/PangoMetrics.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"
#include "ui/gtk/WidgetNavigation.h"

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
    void present();
    void hide();
    /// Shows one after the other.
    void showAlert(const ui::Alert& alert);

    /// Shows an event that has just happened, for some seconds.
    void setMessage(const std::string& text);
    void setNote(std::string text);
    void setStream(std::string state);
    void setAlarms(const std::vector<std::string>& names);
    void setOrigin(const std::string& technology, const std::string& source);
    /// The values are from before this time; "": they are current.
    void setOldValues(const std::string& time);
    /// In place of everything: nothing comes any more, because of what the sentence says.
    void showEnded(const std::string& sentence);

    /// At the right of the title bar.
    void setMenu(GtkWidget* button);
    void setDetail(GtkWidget* widget);

private:
    void build();
    void listen();
    GtkWidget* buildToolbar();
    void showToolbarItems(const ui::BarItems& items);
    void showRemarks();
    void back();
    gboolean handleKey(guint key, guint code, GdkModifierType state);

    Guard _guard;
    Actions _actions;
    Ref<GtkWidget> _window;
    PangoMetrics _metrics;
    WidgetNavigation* _stack = nullptr;
    // The window owns what follows.
    AdwToastOverlay* _toasts;
    GtkStack* _pages;
    AdwHeaderBar* _header;
    AdwWindowTitle* _title;
    GtkButton* _back;
    GtkLabel* _oldValues;
    AdwBin* _panes;
    GtkBox* _toolbar;
    GtkSpinner* _spinner;
    GtkLabel* _status;
    GtkLabel* _remarks;
    GtkButton* _save;
    GtkWidget* _modal = nullptr;
    Ref<GtkWidget> _detail; ///< beside the root pane
    std::function<void()> _saveAction = [] {};
    std::string _note;
    std::string _stream;
    std::string _alarms;
    std::vector<std::pair<gpointer, gulong>> _handlers;
};

} // namespace pallax::gtk
