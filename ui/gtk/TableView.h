#pragma once

#include "app/table/TableModel.h"
#include "ui/gtk/ColumnPlanner.h"
#include "ui/gtk/ColumnStrip.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"
#include "ui/gtk/TableHeadings.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <gtk/gtk.h>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace pallax::gtk {

/// A table of a model: headings that sort, and rows. What does not fit is pushed sideways, below
/// the columns that tell the rows apart. Only the rows in view are filled.
class TableView {
public:
    /// `open` is called when the row under the model's cursor is chosen. `metrics` must outlive the
    /// table.
    TableView(const PangoMetrics& metrics, const Guard& guard, std::function<void()> open);
    ~TableView();
    TableView(const TableView&) = delete;
    TableView& operator=(const TableView&) = delete;

    /// Whoever changes the model calls `refresh` then.
    TableModel& model() { return _model; }
    void refresh();
    void setFilter(std::string text);
    /// Brings the cursor's row into view, and the keyboard to it.
    void focusCursor();
    /// For screen readers.
    void setName(const std::string& name);

    GtkWidget* widget() const { return GTK_WIDGET(_box.get()); }

private:
    /// A row of the list that has widgets.
    struct Bound {
        std::unique_ptr<ColumnStrip> strip;
        std::vector<GtkLabel*> labels = {}; ///< one for each place of the plan
        std::uint64_t plan = 0;             ///< the number of the plan that they are made for
        bool isStale = false;
    };

    void makeList();
    void listen();
    void setUp(GtkListItem* item);
    void bind(GtkListItem* item);
    void tearDown(GtkListItem* item);
    gboolean handleKey(guint key, GdkModifierType state);
    bool pushSideways(double points);
    void copy();

    void adoptPlan();
    void syncItems();
    void makeLabels(Bound& bound) const;
    void fill(Bound& bound, std::size_t shown) const;
    void fillCell(GtkLabel* label, std::size_t row, std::size_t column) const;
    std::string spokenName(std::size_t row) const;
    void fillView(bool onlyStale);
    int rowHeight() const;
    void afterLayout();
    gboolean tick();
    void columnsChanged();
    void grabFocus();
    void moveStrips();
    void revealChosen();
    std::optional<std::size_t> focusedRow() const;
    void focusMoved();
    /// Runs a block later, unless the table is gone by then.
    void later(void (TableView::*action)());

    const PangoMetrics& _metrics;
    Guard _guard;
    std::function<void()> _open;
    TableModel _model;
    ColumnPlanner _planner;
    ColumnPlan _plan;
    std::uint64_t _planNumber = 0;
    Ref<GtkBox> _box;
    GtkScrolledWindow* _scroller; // the box owns it and what follows
    GtkListView* _list = nullptr;
    std::unique_ptr<TableHeadings> _headings;
    Ref<GListStore> _items;         ///< an object for each shown row, which stays with its key
    std::vector<std::string> _keys; ///< of the items
    std::map<GtkListItem*, Bound> _bound;
    bool _isSyncing = false; ///< the list is being changed by us
    // What follows the next layout.
    guint _tick = 0; ///< of what waits for it
    int _framesToWait = 0;
    bool _wantsFocus = false;
    bool _wantsChosen = false;
    std::vector<std::pair<gpointer, gulong>> _handlers;
    std::shared_ptr<TableView*> _alive = std::make_shared<TableView*>(this);
};

} // namespace pallax::gtk
