#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

/// A bar with a field, of which only rows that contain its text are shown.
class FilterBar {
public:
    /// `filter` gets each new text, and "" when the bar is closed.
    FilterBar(const Guard& guard, std::function<void(const std::string& text)> filter);
    FilterBar(const FilterBar&) = delete;
    FilterBar& operator=(const FilterBar&) = delete;

    void toggle();
    void close() { gtk_search_bar_set_search_mode(_bar.get(), FALSE); }
    GtkWidget* widget() const { return GTK_WIDGET(_bar.get()); }

private:
    Ref<GtkSearchBar> _bar;
    GtkSearchEntry* _field; ///< the bar owns it
};

} // namespace pallax::gtk
