#include "ui/gtk/ChangesView.h"

#include "ui/contents/ChangesContent.h"
#include "ui/gtk/PageParts.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

namespace pallax::gtk {

namespace {

constexpr int kLineGap = 4;
constexpr int kBlankWidth = 6; // of a blank before a line

GtkWidget* wrappedLabel(const std::string& text) {
    GtkWidget* label = gtk_label_new(shownText(text).c_str());
    gtk_label_set_xalign(GTK_LABEL(label), 0);
    gtk_label_set_yalign(GTK_LABEL(label), 0);
    gtk_label_set_wrap(GTK_LABEL(label), TRUE);
    gtk_label_set_selectable(GTK_LABEL(label), TRUE); // to copy it
    return label;
}

} // namespace

ChangesView::ChangesView() : _scroller(pageScroller()), _box(pageBox()) {
    gtk_scrolled_window_set_child(_scroller.get(), GTK_WIDGET(_box));
}

void ChangesView::show(const std::string& title, const std::vector<std::string>& lines) {
    if (title != _title || lines != _lines) {
        _title = title;
        _lines = lines;
        build();
    }
}

void ChangesView::build() {
    while (GtkWidget* child = gtk_widget_get_first_child(GTK_WIDGET(_box))) {
        gtk_box_remove(_box, child);
    }
    addHeading(_title, "title-2");
    GtkGrid* section = nullptr; // of the lines that follow
    int row = 0;
    for (const std::string& line : _lines) {
        if (line.empty()) {
            continue;
        }
        if (!line.starts_with(' ')) {
            addHeading(line, "heading");
            section = nullptr;
            continue;
        }
        if (section == nullptr) {
            section = GTK_GRID(gtk_grid_new());
            gtk_grid_set_column_spacing(section, kPageBorder);
            gtk_grid_set_row_spacing(section, kLineGap);
            gtk_box_append(_box, GTK_WIDGET(section));
            row = 0;
        }
        addLine(section, row++, line);
    }
    if (_lines.empty()) {
        addHeading(translated("Nothing differs."), nullptr);
    }
}

void ChangesView::addHeading(const std::string& text, const char* look) {
    GtkWidget* label = wrappedLabel(text);
    if (look != nullptr) {
        gtk_widget_add_css_class(label, look);
    }
    gtk_box_append(_box, label);
}

/// Its name at the left, what has changed at the right; an entry has its name alone.
void ChangesView::addLine(GtkGrid* to, int row, const std::string& line) {
    const ChangeParts parts = changeParts(line);
    GtkWidget* name = wrappedLabel(parts.name);
    gtk_widget_set_margin_start(name, static_cast<int>(parts.depth) * kBlankWidth);
    gtk_grid_attach(to, name, 0, row, parts.change.empty() ? 2 : 1, 1);
    if (!parts.change.empty()) {
        gtk_widget_add_css_class(name, "dim-label");
        GtkWidget* change = wrappedLabel(parts.change);
        gtk_widget_set_hexpand(change, TRUE);
        gtk_grid_attach(to, change, 1, row, 1, 1);
    }
}

} // namespace pallax::gtk
