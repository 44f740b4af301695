#pragma once

#include "ui/gtk/TableView.h"

#include <functional>
#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

/// A page with a table. Above it is room for fields, and a sentence about what it shows; without
/// rows, the sentence stands in its place.
class TablePage {
public:
    /// As for TableView.
    TablePage(const PangoMetrics& metrics, const Guard& guard, std::function<void()> open);
    TablePage(const TablePage&) = delete;
    TablePage& operator=(const TablePage&) = delete;

    TableView& table() { return _table; }
    TableModel& model() { return _table.model(); }
    /// Above the table.
    void addField(GtkWidget* field);
    /// Shows the model. `sentence` may be empty.
    void show(const std::string& sentence);
    GtkWidget* widget() const { return GTK_WIDGET(_box.get()); }

private:
    Ref<GtkBox> _box;
    GtkBox* _fields; ///< the box owns it and what follows
    GtkLabel* _sentence;
    TableView _table;
};

} // namespace pallax::gtk
