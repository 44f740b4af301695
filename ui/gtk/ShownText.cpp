#include "ui/gtk/ShownText.h"

#include "text/Printable.h"

namespace pallax::gtk {

std::string shownText(std::string_view text) {
    return printable(text);
}

std::string shownLines(std::string_view text) {
    std::string shown;
    appendPrintableLines(shown, text);
    return shown;
}

std::string shownMarkup(std::string_view text) {
    const std::string shown = shownText(text);
    gchar* escaped = g_markup_escape_text(shown.data(), static_cast<gssize>(shown.size()));
    std::string markup = escaped;
    g_free(escaped);
    return markup;
}

void showText(GtkLabel* label, std::string_view text) {
    gtk_label_set_text(label, shownText(text).c_str());
    gtk_widget_set_visible(GTK_WIDGET(label), text.empty() ? FALSE : TRUE);
}

void showTooltip(GtkWidget* widget, std::string_view text) {
    const std::string shown = shownText(text);
    const char* const known = gtk_widget_get_tooltip_text(widget);
    if (shown != (known == nullptr ? "" : known)) {
        gtk_widget_set_tooltip_text(widget, shown.empty() ? nullptr : shown.c_str());
    }
}

void nameWidget(GtkWidget* widget, const char* name) {
    gtk_widget_set_tooltip_text(widget, name);
    gtk_accessible_update_property(GTK_ACCESSIBLE(widget), GTK_ACCESSIBLE_PROPERTY_LABEL, name, -1);
}

bool isSeen(GtkWidget* widget) {
    if (gtk_widget_get_mapped(widget) == FALSE) {
        return false;
    }
    GdkSurface* surface = gtk_native_get_surface(gtk_widget_get_native(widget));
    return !GDK_IS_TOPLEVEL(surface) ||
           (gdk_toplevel_get_state(GDK_TOPLEVEL(surface)) & GDK_TOPLEVEL_STATE_MINIMIZED) == 0;
}

} // namespace pallax::gtk
