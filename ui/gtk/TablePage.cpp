#include "ui/gtk/TablePage.h"

#include "ui/gtk/ShownText.h"

#include <utility>

namespace pallax::gtk {

namespace {

constexpr int kFieldMargin = 10;

} // namespace

TablePage::TablePage(const PangoMetrics& metrics, const Guard& guard, std::function<void()> open)
    : _box(owned(GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0)))),
      _fields(GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, kFieldMargin))),
      _sentence(GTK_LABEL(gtk_label_new(nullptr))), _table(metrics, guard, std::move(open)) {
    gtk_widget_set_visible(GTK_WIDGET(_fields), FALSE);
    for (GtkWidget* each : {GTK_WIDGET(_fields), GTK_WIDGET(_sentence)}) {
        for (const auto& set : {gtk_widget_set_margin_top, gtk_widget_set_margin_bottom,
                                gtk_widget_set_margin_start, gtk_widget_set_margin_end}) {
            set(each, kFieldMargin);
        }
        gtk_box_append(_box.get(), each);
    }
    gtk_label_set_wrap(_sentence, TRUE);
    gtk_label_set_wrap_mode(_sentence, PANGO_WRAP_WORD_CHAR);
    gtk_label_set_xalign(_sentence, 0);
    gtk_label_set_selectable(_sentence, TRUE); // to copy it
    gtk_box_append(_box.get(), _table.widget());
    gtk_widget_set_vexpand(widget(), TRUE);
    show("");
}

void TablePage::addField(GtkWidget* field) {
    gtk_box_append(_fields, field);
    gtk_widget_set_visible(GTK_WIDGET(_fields), TRUE);
}

void TablePage::show(const std::string& sentence) {
    showText(_sentence, sentence);
    gtk_widget_set_visible(_table.widget(), model().content().rows.empty() ? FALSE : TRUE);
    _table.refresh();
}

} // namespace pallax::gtk
