#include "ui/gtk/FilterBar.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

namespace pallax::gtk {

/// What the signals call does not use the object: the widgets may outlive it.
FilterBar::FilterBar(const Guard& guard, std::function<void(const std::string& text)> filter)
    : _bar(owned(GTK_SEARCH_BAR(gtk_search_bar_new()))),
      _field(GTK_SEARCH_ENTRY(gtk_search_entry_new())) {
    gtk_search_bar_set_child(_bar.get(), GTK_WIDGET(_field));
    gtk_search_bar_connect_entry(_bar.get(), GTK_EDITABLE(_field));
    gtk_widget_set_hexpand(GTK_WIDGET(_field), TRUE);
    nameWidget(GTK_WIDGET(_field), translated("Show rows that contain a text"));
    // At once: "search-changed" comes later, when another pane may be open.
    onSignal(_field, "changed", guard,
             [field = _field, filter] { filter(gtk_editable_get_text(GTK_EDITABLE(field))); });
    onSignal(_bar.get(), "notify::search-mode-enabled", guard,
             [bar = _bar.get(), field = _field, filter] {
                 if (gtk_search_bar_get_search_mode(bar) == FALSE) {
                     gtk_editable_set_text(GTK_EDITABLE(field), "");
                     filter("");
                 }
             });
}

void FilterBar::toggle() {
    const bool isOpen = gtk_search_bar_get_search_mode(_bar.get()) != FALSE;
    gtk_search_bar_set_search_mode(_bar.get(), isOpen ? FALSE : TRUE);
}

} // namespace pallax::gtk
