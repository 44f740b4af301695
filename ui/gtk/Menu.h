#pragma once

#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <optional>
#include <string>
#include <vector>

namespace pallax::gtk {

struct MenuEntry {
    std::string name; ///< of its action: "open"
    std::string label;
    std::function<void()> action;
    /// Of an entry with a check mark, whether it is set, asked whenever the action has run.
    std::function<bool()> isOn = nullptr;
    /// The entry is there while this widget is visible, which must outlive the menu; null: always.
    GtkWidget* besides = nullptr;
};

/// A button with a menu of these sections, whose actions are the window's ("window.open").
GtkWidget* menuButton(GtkWindow* window, const Guard& guard,
                      const std::vector<std::vector<MenuEntry>>& sections);

} // namespace pallax::gtk
