#include "ui/gtk/WidgetTable.h"

#include <utility>

namespace pallax::gtk {

bool WidgetTable::isListWithColumns() const {
    return _look != nullptr && showsTable(pane());
}

/// Comes at each tick, so that the table knows what has changed.
void WidgetTable::refreshTable() {
    const bool isTable = isShownAsTable();
    if (isTable && _columns == nullptr) {
        _columns = std::make_unique<gtk::TableView>(_metrics, _guard, [this] {
            if (const auto row = _columns->model().cursorRow()) {
                openRow(*row);
            }
        });
        gtk_box_append(_content, _columns->widget());
    }
    gtk_widget_set_visible(GTK_WIDGET(_scroller), isTable ? FALSE : TRUE);
    if (_columns != nullptr) {
        gtk_widget_set_visible(_columns->widget(), isTable ? TRUE : FALSE);
    }
    if (isTable) {
        _listed.refresh(_columns->model(), pane(), *_look);
        _listed.refreshAges(_columns->model(), pane(), *_look);
        _columns->setName(pane().title());
        _columns->refresh();
    } else {
        _listed.forget();
    }
}

std::optional<std::size_t> WidgetTable::cursorRow() const {
    if (isShownAsTable() && _columns != nullptr) {
        return _columns->model().cursorRow();
    }
    const auto focused = focusedRow();
    return focused ? focused : pane().cursorRow();
}

void WidgetTable::switchLook() {
    const bool wasTable = isShownAsTable();
    const auto row = cursorRow();
    setFilter("");
    _look->asTables = !wasTable;
    reloadData();
    select(row.value_or(0));
}

void WidgetTable::select(std::size_t row) {
    if (isShownAsTable()) {
        TableModel& table = _columns->model();
        table.select(row);
        if (table.cursorRow() != row) {
            table.setFilter("");
            table.select(row);
        }
        _columns->refresh();
        return _columns->focusCursor();
    }
    const auto isHidden = [&] {
        for (std::size_t shown = 0; shown < pane().shownRows(); ++shown) {
            if (pane().rowAt(shown) == row) {
                pane().moveCursorTo(shown);
                return false;
            }
        }
        return true;
    };
    if (isHidden()) {
        setFilter("");
        (void)isHidden();
    }
    _wanted = pane().row(row).name;
    focusWanted();
}

/// Before the list has its size, it cannot scroll to a row.
void WidgetTable::focusWanted() {
    GtkAdjustment* vertical = gtk_scrolled_window_get_vadjustment(_scroller);
    GtkRoot* const root = gtk_widget_get_root(GTK_WIDGET(_list));
    if (_wanted && root != nullptr && gtk_adjustment_get_page_size(vertical) > 0) {
        gtk_widget_activate_action(GTK_WIDGET(_list), "list.scroll-to-item", "u",
                                   static_cast<guint>(pane().cursor()));
        gtk_window_set_focus_visible(GTK_WINDOW(root), TRUE);
        focusRow(*std::exchange(_wanted, std::nullopt));
    }
}

} // namespace pallax::gtk
