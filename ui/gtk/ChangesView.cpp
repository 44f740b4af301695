#include "ui/gtk/ChangesView.h"

#include "ui/gtk/PageParts.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

namespace pallax::gtk {

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
    addLabel(_title, "title-2");
    std::string section; // the lines of one
    const auto finish = [this, &section] {
        if (!section.empty()) {
            addLabel(section, "monospace");
            section.clear();
        }
    };
    for (const std::string& line : _lines) {
        if (line.starts_with(' ')) {
            section += (section.empty() ? "" : "\n") + line;
        } else if (!line.empty()) {
            finish();
            addLabel(line, "heading");
        }
    }
    finish();
    if (_lines.empty()) {
        addLabel(translated("Nothing differs."), nullptr);
    }
}

void ChangesView::addLabel(const std::string& text, const char* look) {
    GtkWidget* label = gtk_label_new(shownLines(text).c_str());
    gtk_label_set_xalign(GTK_LABEL(label), 0);
    gtk_label_set_wrap(GTK_LABEL(label), TRUE);
    gtk_label_set_selectable(GTK_LABEL(label), TRUE); // to copy it
    if (look != nullptr) {
        gtk_widget_add_css_class(label, look);
    }
    gtk_box_append(_box, label);
}

} // namespace pallax::gtk
