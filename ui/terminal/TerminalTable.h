#pragma once

#include "platform/ui/TableView.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {

/// A table of which a terminal shows a window of rows, with a cursor on one of them. The cursor
/// keeps to its row, by name, when the rows change.
///
/// Row numbers are the source's, but for `shown…`: those count the rows that pass the filter.
class TerminalTable final : public ui::TableView {
public:
    /// Called when something must be drawn anew.
    using NeedsDisplay = std::function<void()>;

    TerminalTable(ui::TableSource& source, ui::Rect contentBounds, NeedsDisplay needsDisplay);

    /// Never gives one: a terminal shows so few rows that it makes a new cell for each.
    std::shared_ptr<ui::TableCell> dequeueReusableCell(std::string_view identifier) override;
    ui::Rect contentBounds() const override { return _contentBounds; }
    void reloadData() override;
    void deselectRow(std::size_t row, bool animated) override;
    void sizeToFit() override;

    /// The room that there is now, in rows; and what a cell has, in points.
    void setViewport(std::size_t rows, ui::Rect contentBounds);

    std::size_t totalRows() const { return _source.numberOfRows(); }
    std::size_t shownRows() const;
    /// The first shown row in the window.
    std::size_t firstShown() const { return _firstShown; }
    /// The row behind a shown one; `shown` is below shownRows().
    std::size_t rowAt(std::size_t shown) const;
    /// The shown row on which the cursor stands; below shownRows() unless there are none.
    std::size_t cursor() const { return _cursor; }
    std::optional<std::size_t> cursorRow() const;

    /// Moves by so many rows, stopping at the ends.
    void moveCursor(std::ptrdiff_t rows);
    void moveCursorTo(std::size_t shown);
    /// Moves the window by so many rows, stopping at the ends; the cursor stays inside it.
    void scroll(std::ptrdiff_t rows);
    /// A window's height, less one row.
    std::ptrdiff_t page() const;
    void moveToEnd() { moveCursorTo(shownRows()); }

    /// Rows whose name or value holds this text stay, whatever the case of ASCII letters; the
    /// empty text lets all stay.
    void setFilter(std::string text);
    const std::string& filter() const { return _filter; }

    /// How far the cursor's row is scrolled sideways, in columns.
    int sidewaysOffset() const { return _sidewaysOffset; }
    /// Scrolls the cursor's row; false when it is at that end already (also one that fits).
    bool scrollSideways(int columns);

    ui::TableSource& source() { return _source; }

private:
    void filterRows();
    void rememberCursor();
    void findCursor();
    /// The last row at which a window can begin without room below its rows.
    std::size_t lastFirstShown() const;
    void keepCursorInWindow();

    ui::TableSource& _source;
    ui::Rect _contentBounds;
    NeedsDisplay _needsDisplay;
    std::size_t _windowRows = 1;
    std::size_t _firstShown = 0;
    std::size_t _cursor = 0;
    std::optional<std::string> _cursorName; // of the row under the cursor, or the last one there
    std::string _filter;
    std::vector<std::size_t> _matches; // the rows that pass, while there is a filter
    int _sidewaysOffset = 0;
};

/// Every table of this front end's screens was made by its toolkit.
TerminalTable& terminalTable(ui::TableView& table);

/// Where `wanted` first stands in `text`, whatever the case of ASCII letters.
std::size_t findIgnoringCase(std::string_view text, std::string_view wanted);

} // namespace pallax::terminal
