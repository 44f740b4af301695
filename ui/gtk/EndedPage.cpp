#include "ui/gtk/EndedPage.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <adwaita.h>
#include <utility>

namespace pallax::gtk {

EndedPage endedPage(const std::string& sentence, const Guard& guard, std::function<void()> closed) {
    GtkWidget* page = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    gtk_box_append(GTK_BOX(page), adw_header_bar_new());
    GtkWidget* status = adw_status_page_new();
    adw_status_page_set_icon_name(ADW_STATUS_PAGE(status), "dialog-error-symbolic");
    adw_status_page_set_title(ADW_STATUS_PAGE(status), translated("Pallax has stopped"));
    adw_status_page_set_description(ADW_STATUS_PAGE(status), shownMarkup(sentence).c_str());
    GtkWidget* close = gtk_button_new_with_label(translated("Close"));
    gtk_widget_add_css_class(close, "pill");
    gtk_widget_set_halign(close, GTK_ALIGN_CENTER);
    onSignal(close, "clicked", guard,
             [guard, closed = std::move(closed)] { guard.queue().async(closed); });
    adw_status_page_set_child(ADW_STATUS_PAGE(status), close);
    gtk_widget_set_vexpand(status, TRUE);
    gtk_box_append(GTK_BOX(page), status);
    return {page, close};
}

} // namespace pallax::gtk
