#include "ui/gtk/SaveScreen.h"

#include "ui/gtk/Translation.h"
#include "ui/gtk/WidgetTable.h"

#include <adwaita.h>

namespace pallax::gtk {

namespace {

constexpr int kMargin = 12;
constexpr int kMostWidth = 600;

GtkWidget* buildHeader(ui::ModalScreen& screen, const Guard& guard) {
    GtkWidget* header = adw_header_bar_new();
    adw_header_bar_set_show_start_title_buttons(ADW_HEADER_BAR(header), FALSE);
    adw_header_bar_set_show_end_title_buttons(ADW_HEADER_BAR(header), FALSE);
    adw_header_bar_set_title_widget(ADW_HEADER_BAR(header),
                                    adw_window_title_new(translated("Save snapshot"), ""));
    GtkWidget* cancel = gtk_button_new_with_label(translated("Cancel"));
    onSignal(cancel, "clicked", guard, [&screen] { screen.cancelPressed(); });
    adw_header_bar_pack_start(ADW_HEADER_BAR(header), cancel);
    GtkWidget* save = gtk_button_new_with_label(translated("Save"));
    gtk_widget_add_css_class(save, "suggested-action");
    onSignal(save, "clicked", guard, [&screen] { screen.savePressed(); });
    adw_header_bar_pack_end(ADW_HEADER_BAR(header), save);
    return header;
}

} // namespace

WidgetTextField& widgetTextField(ui::TextField& field) {
    return static_cast<WidgetTextField&>(field);
}

GtkWidget* saveScreen(ui::ModalScreen& screen, const Guard& guard) {
    GtkWidget* page = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    gtk_box_append(GTK_BOX(page), buildHeader(screen, guard));

    GtkWidget* content = gtk_box_new(GTK_ORIENTATION_VERTICAL, kMargin);
    for (const auto& set : {gtk_widget_set_margin_top, gtk_widget_set_margin_bottom,
                            gtk_widget_set_margin_start, gtk_widget_set_margin_end}) {
        set(content, kMargin);
    }
    GtkWidget* list = widgetTable(screen.list()).widget();
    gtk_widget_add_css_class(list, "card");
    gtk_widget_set_vexpand(list, FALSE);
    gtk_box_append(GTK_BOX(content), list);
    GtkWidget* field = widgetTextField(screen.field()).widget();
    GtkWidget* label = gtk_label_new(translated("Description"));
    gtk_label_set_xalign(GTK_LABEL(label), 0);
    gtk_accessible_update_relation(GTK_ACCESSIBLE(field), GTK_ACCESSIBLE_RELATION_LABELLED_BY,
                                   label, nullptr, -1);
    gtk_box_append(GTK_BOX(content), label);
    gtk_box_append(GTK_BOX(content), field);

    GtkWidget* clamp = adw_clamp_new();
    adw_clamp_set_maximum_size(ADW_CLAMP(clamp), kMostWidth);
    adw_clamp_set_child(ADW_CLAMP(clamp), content);
    gtk_widget_set_vexpand(clamp, TRUE);
    GtkGesture* touch = gtk_gesture_click_new();
    onSignal(touch, "pressed", guard, [&screen] { screen.backgroundTouched(); });
    gtk_widget_add_controller(clamp, GTK_EVENT_CONTROLLER(touch));
    gtk_box_append(GTK_BOX(page), clamp);
    widgetTable(screen.list()).reloadData();
    return page;
}

} // namespace pallax::gtk
