#pragma once

#include "app/pane/PaneModel.h"
#include "app/table/PaneTable.h"
#include "platform/ui/TableView.h"
#include "ui/gtk/PangoMetrics.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/RowView.h"
#include "ui/gtk/Signals.h"
#include "ui/gtk/TableView.h"

#include <cstddef>
#include <functional>
#include <gtk/gtk.h>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace pallax::gtk {

/// A table as a list of widgets, which scrolls. Only the rows in view are filled at each new data;
/// the others when they come into view. Its source owns a pane.
class WidgetTable final : public ui::TableView {
public:
    /// `metrics` and `look` must outlive the table. The content area of its cells begins at `inset`
    /// points. Without a look, lists are rows.
    WidgetTable(ui::TableSource& source, const PangoMetrics& metrics, const Guard& guard,
                double inset = 0, ListLook* look = nullptr);
    ~WidgetTable() override;
    WidgetTable(const WidgetTable&) = delete;
    WidgetTable& operator=(const WidgetTable&) = delete;

    /// Always null, as in every front end that shows each row's value: the cell of a branch has no
    /// label for one.
    std::shared_ptr<ui::TableCell> dequeueReusableCell(std::string_view identifier) override;
    ui::Rect contentBounds() const override;
    void reloadData() override;
    void deselectRow(std::size_t row, bool animated) override;
    /// Shows all rows without scrolling, up to half of the window.
    void sizeToFit() override;

    GtkWidget* widget() const { return GTK_WIDGET(_widget.get()); }
    /// Called before a row is selected.
    void onSelecting(std::function<void()> action) { _selecting = std::move(action); }
    /// Called after a row with a value was selected, with its path in the display and its text.
    void onLeaf(std::function<void(const std::string& path, const std::string& text)> action) {
        _leafSelected = std::move(action);
    }
    /// Marks the row whose pane is shown beside the table; nothing: none is.
    void setOpenRow(std::optional<std::string> name);
    void setFilter(std::string text);
    PaneModel& pane() const;
    /// Whether the pane shows a list that can be a table with columns, and whether it is one.
    bool isListWithColumns() const;
    bool isShownAsTable() const { return isListWithColumns() && _look->asTables; }
    /// The row of the source under the keyboard or, if that is elsewhere, the one that was selected
    /// last.
    std::optional<std::size_t> cursorRow() const;
    /// The path in the display of the row under the keyboard; nothing unless it shows a value.
    std::optional<std::string> focusedValue() const;
    /// Shows lists as tables, or as rows again. The cursor stays on its entry.
    void switchLook();
    /// Brings a row of the source into view, and the keyboard to it. Clears the filter if it hides
    /// the row.
    void select(std::size_t row);

private:
    /// A row of the list that has widgets.
    struct Bound {
        std::unique_ptr<RowView> view;
        std::string name; ///< of the row that it shows
        bool isStale = false;
    };
    /// The shown rows in view, [first, past).
    struct Range {
        std::size_t first;
        std::size_t past;
    };

    void makeList();
    void listen();
    void setUp(GtkListItem* item);
    void bind(GtkListItem* item);
    void tearDown(GtkListItem* item);
    void activate(guint position);
    gboolean handleKey(guint key);
    void fill(Bound& bound, std::size_t shown);
    RowNotes notesOf(const PaneRow& row) const;
    Range rowsInView() const;
    void fillView(bool onlyStale);
    void refreshTable();
    void focusWanted();
    void openRow(std::size_t row);
    void showPlaceholder();
    void remember(const Bound& bound, double offset);
    void widthChanged();
    static bool hasFocus(const Bound& bound);
    std::optional<std::size_t> focusedRow() const;
    void focusRow(const std::string& name);
    /// Runs a block later, unless the table is gone by then.
    void later(void (WidgetTable::*action)());

    ui::TableSource& _source;
    const PangoMetrics& _metrics;
    Guard _guard;
    mutable PaneModel* _pane = nullptr; ///< the source's, once it was asked for
    Ref<GtkOverlay> _widget;
    GtkBox* _content;             ///< the rows, or the table with columns
    GtkScrolledWindow* _scroller; // the widget owns it and what follows
    GtkListView* _list = nullptr;
    GtkLabel* _placeholder = nullptr;
    Ref<GtkStringList> _rows;
    std::map<GtkListItem*, Bound> _bound;
    std::map<std::string, double> _offsets; ///< of rows that are scrolled sideways, by name
    std::optional<std::string> _openRow;
    std::optional<std::string> _wanted; ///< the row that gets the keyboard as soon as it can
    std::function<void()> _selecting = [] {};
    std::function<void(const std::string&, const std::string&)> _leafSelected =
        [](const std::string& /*path*/, const std::string& /*text*/) {};
    ListLook* _look;
    PaneTable _listed;                        ///< fills the table with columns
    std::unique_ptr<gtk::TableView> _columns; ///< once it was shown
    double _inset;
    double _width; ///< of a cell's content, in points
    std::vector<std::pair<gpointer, gulong>> _handlers;
    std::shared_ptr<WidgetTable*> _alive = std::make_shared<WidgetTable*>(this);
};

/// Every table of this front end's screens comes from its toolkit.
WidgetTable& widgetTable(ui::TableView& table);

} // namespace pallax::gtk
