#pragma once

#include "app/pane/PaneModel.h"
#include "app/table/PaneTable.h"
#include "platform/ui/TableView.h"
#include "ui/drawing/ColumnTable.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace pallax::terminal {

/// A table of which a terminal shows a window of rows. Its source owns a pane, which knows the
/// rows, the filter and the cursor; the window follows the cursor. A list can be shown as a table
/// with columns, which has a filter and a cursor of its own.
class TerminalTable final : public ui::TableView {
public:
    /// Called when a redraw is needed.
    using NeedsDisplay = std::function<void()>;

    /// Without a look, which must outlive the table, lists are rows.
    TerminalTable(ui::TableSource& source, ui::Rect contentBounds, NeedsDisplay needsDisplay,
                  ListLook* look = nullptr);

    /// Always null: a terminal shows so few rows that it creates a new cell for each.
    std::shared_ptr<ui::TableCell> dequeueReusableCell(std::string_view identifier) override;
    ui::Rect contentBounds() const override { return _contentBounds; }
    void reloadData() override;
    void deselectRow(std::size_t row, bool animated) override;
    void sizeToFit() override;

    /// The available rows, and the area of a cell in points.
    void setViewport(std::size_t rows, ui::Rect contentBounds);

    /// The source's pane.
    PaneModel& pane() const;
    /// The table with columns, while the pane shows one; else null.
    ColumnTable* list();
    /// Whether the pane shows a list that can be a table with columns.
    bool isListWithColumns() const;
    /// Takes the keys of lists and of tables with columns.
    void handleListKey(char32_t character);

    /// The first shown row in the window.
    std::size_t firstShown() const { return _firstShown; }
    /// The rows above and below the window.
    std::size_t rowsAbove();
    std::size_t rowsBelow();
    /// The rows that pass the filter.
    std::size_t shownRows();
    /// The source's row under the cursor.
    std::optional<std::size_t> selectedRow();
    std::optional<std::string> copied();
    const std::string& filter();

    /// Moves the cursor by so many rows, stopping at the ends.
    void moveCursor(std::ptrdiff_t rows);
    void moveCursorTo(std::size_t shown);
    /// Moves the cursor to a row of the source. Clears the filter if it hides the row.
    void select(std::size_t row);
    /// Moves the window by this many rows, stopping at the ends; the cursor stays inside.
    void scroll(std::ptrdiff_t rows);
    /// The height of the window less one row.
    std::ptrdiff_t page();
    void moveToEnd() { moveCursorTo(shownRows()); }

    /// The pane's filter; the window follows the cursor.
    void setFilter(std::string text);

    /// How far the cursor's row is scrolled sideways, in columns.
    int sidewaysOffset() const { return _sidewaysOffset; }
    /// Scrolls the cursor's row, or a table by a column; false if it is already at that end, or
    /// fits.
    bool scrollSideways(int columns);

    ui::TableSource& source() { return _source; }

private:
    std::optional<std::string> cursorName() const;
    /// The last row at which a window can begin without room below its rows.
    std::size_t lastFirstShown() const;
    void keepCursorInWindow();
    void switchLook();

    ui::TableSource& _source;
    mutable PaneModel* _pane = nullptr; ///< the source's, once it was asked for
    ui::Rect _contentBounds;
    NeedsDisplay _needsDisplay;
    ListLook* _look;
    PaneTable _listed; ///< fills the table with columns
    ColumnTable _list;
    std::size_t _windowRows = 1;
    std::size_t _firstShown = 0;
    int _sidewaysOffset = 0;
    std::optional<std::string> _scrolledName; ///< of the row that is scrolled sideways
};

/// Every table of this front end's screens comes from its toolkit.
TerminalTable& terminalTable(ui::TableView& table);

} // namespace pallax::terminal
