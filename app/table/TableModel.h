#pragma once

#include "app/table/TableContent.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A table without a toolkit. One column can be chosen: the rows are sorted by it. The cursor stays
/// on its row, by key, when the rows change.
///
/// Rows and columns are numbered as in the content. Only numbers called `shown` count the rows that
/// pass the filter, in their order on the screen.
class TableModel {
public:
    enum class Changes { Mark, Ignore };

    /// Shows another table: nothing is chosen, hidden, filtered or marked as changed.
    void show(TableContent content);
    /// Shows the same table with new content. With Mark, cells whose text differs from the row of
    /// that key before, and all cells of new rows, have changed.
    void update(TableContent content, Changes changes);
    const TableContent& content() const { return _content; }
    /// Differs after each `show` and `update`.
    std::uint64_t version() const { return _version; }
    bool hasChanged(std::size_t row, std::size_t column) const;

    /// Shows only rows with a cell that contains this text, ignoring the case of ASCII letters. The
    /// empty text shows all rows.
    void setFilter(std::string text);
    const std::string& filter() const { return _filter; }

    std::size_t shownRows() const { return _shown.size(); }
    /// `shown` must be below shownRows().
    std::size_t rowAt(std::size_t shown) const { return _shown[shown]; }

    /// The cursor's shown row; below shownRows() unless there are none.
    std::size_t cursor() const { return _cursor; }
    std::optional<std::size_t> cursorRow() const;
    /// Numbers beyond the last row mean the last row.
    void moveCursorTo(std::size_t shown);
    /// Moves the cursor to a row of the content, if it is shown.
    void select(std::size_t row);

    /// Replaces the cells of a column, by row. Nothing is marked as changed.
    void setCells(std::size_t column, std::vector<TableCell> cells);

    /// The columns that are not hidden, and of the extra ones those that are shown.
    std::vector<std::size_t> columns() const;
    bool hidesColumns() const { return !_hiddenNames.empty(); }
    /// The column by which the rows are sorted; nothing: the rows are in the order of the content.
    std::optional<std::size_t> chosenColumn() const { return _chosen; }
    bool isDescending() const { return _isDescending; }
    void choose(std::size_t column);
    /// Chooses the next column, or the one before; before the first column is none.
    void chooseNext();
    void choosePrevious();
    void reverse();
    /// Hides a column; if it was chosen, its neighbour is. The last column stays.
    void hide(std::size_t column);
    void hideChosen();
    void showAllColumns();

    /// The cursor's value in the chosen column with its unit, or else its identity, or without one
    /// the whole row with tabs between its values. Nothing without a row or a value.
    std::optional<std::string> copied() const;

private:
    bool isHidden(std::size_t column) const;
    /// Those that are not hidden, extra ones included.
    std::vector<std::size_t> choices() const;
    bool passes(const TableRow& row) const;
    /// The position of a column among the choices.
    std::size_t placeOf(std::size_t column) const;
    void markChanges(const TableContent& before);
    void resolveColumns();
    /// Selects and sorts the shown rows, then finds the cursor's row.
    void arrange();
    void rememberCursor();
    void findCursor();

    TableContent _content;
    std::uint64_t _version = 0;
    std::vector<bool> _changed; ///< by row and column; empty: nothing has changed
    std::string _filter;
    std::vector<std::size_t> _shown;
    std::size_t _cursor = 0;
    std::optional<std::string> _cursorKey; ///< of the row under the cursor, now or last
    std::optional<std::size_t> _chosen;
    std::optional<std::string> _chosenName; ///< a chosen column may vanish and return
    bool _isDescending = false;
    std::vector<std::string> _hiddenNames;
    bool _showsExtra = false;
};

} // namespace pallax
