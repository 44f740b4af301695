#include "ui/gtk/PageParts.h"

#include "ui/gtk/ShownText.h"

namespace pallax::gtk {

Ref<GtkScrolledWindow> pageScroller() {
    auto scroller = owned(GTK_SCROLLED_WINDOW(gtk_scrolled_window_new()));
    gtk_scrolled_window_set_policy(scroller.get(), GTK_POLICY_NEVER, GTK_POLICY_AUTOMATIC);
    gtk_widget_set_vexpand(GTK_WIDGET(scroller.get()), TRUE);
    return scroller;
}

GtkBox* pageBox() {
    GtkWidget* box = gtk_box_new(GTK_ORIENTATION_VERTICAL, kPageBorder);
    for (const auto& set : {gtk_widget_set_margin_top, gtk_widget_set_margin_bottom,
                            gtk_widget_set_margin_start, gtk_widget_set_margin_end}) {
        set(box, kPageBorder);
    }
    return GTK_BOX(box);
}

void changeText(GtkLabel* label, std::string_view text) {
    const std::string shown = shownLines(text);
    if (shown != gtk_label_get_text(label)) {
        gtk_label_set_text(label, shown.c_str());
    }
    gtk_widget_set_visible(GTK_WIDGET(label), text.empty() ? FALSE : TRUE);
}

} // namespace pallax::gtk
