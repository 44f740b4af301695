#include "ui/gtk/PageStack.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <adwaita.h>
#include <algorithm>
#include <utility>

namespace pallax::gtk {

void PageStack::open(GtkWidget* widget, const std::string& title,
                     std::function<void(const std::string& text)> filter) {
    const auto same = std::find_if(_pages.begin(), _pages.end(),
                                   [widget](const Page& page) { return page.content == widget; });
    if (same != _pages.end()) {
        remove(*same);
        _pages.erase(same);
    }
    Page page{gtk_box_new(GTK_ORIENTATION_VERTICAL, 0), widget, nullptr};
    GtkWidget* back = gtk_button_new_from_icon_name("go-previous-symbolic");
    nameWidget(back, translated("Back"));
    onSignal(back, "clicked", _guard, [this] { close(); });
    GtkWidget* header = adw_header_bar_new();
    adw_header_bar_pack_start(ADW_HEADER_BAR(header), back);
    adw_header_bar_set_title_widget(ADW_HEADER_BAR(header),
                                    adw_window_title_new(shownText(title).c_str(), ""));
    gtk_box_append(GTK_BOX(page.box), header);
    if (filter) {
        page.filter = std::make_unique<FilterBar>(_guard, std::move(filter));
        gtk_box_append(GTK_BOX(page.box), page.filter->widget());
    }
    gtk_box_append(GTK_BOX(page.box), widget);
    gtk_stack_add_child(_stack, page.box);
    _pages.push_back(std::move(page));
    showTop();
    gtk_widget_grab_focus(back);
}

void PageStack::showTop() {
    gtk_stack_set_visible_child(_stack, isOpen() ? _pages.back().box
                                                 : gtk_widget_get_first_child(GTK_WIDGET(_stack)));
}

/// What comes into view gets the keyboard back, so it is shown before the page goes.
void PageStack::close() {
    if (!isOpen()) {
        return;
    }
    const Page closing = std::move(_pages.back());
    _pages.pop_back();
    showTop();
    remove(closing);
    if (isOpen()) {
        _uncovered();
    }
}

void PageStack::closeAll() {
    const std::vector<Page> closing = std::exchange(_pages, {});
    showTop();
    for (const Page& page : closing) {
        remove(page);
    }
}

/// The content may come back, and then all of it is shown.
void PageStack::remove(const Page& page) {
    if (page.filter != nullptr) {
        page.filter->close();
    }
    gtk_box_remove(GTK_BOX(page.box), page.content);
    gtk_stack_remove(_stack, page.box);
}

void PageStack::toggleFilter() {
    if (isOpen() && _pages.back().filter != nullptr) {
        _pages.back().filter->toggle();
    }
}

} // namespace pallax::gtk
