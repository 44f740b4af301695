#pragma once

#include "app/table/TableModel.h"
#include "ui/drawing/Grid.h"
#include "ui/drawing/HitMap.h"
#include "ui/drawing/Keys.h"
#include "ui/drawing/Marks.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace pallax::terminal {

/// A table on the screen: a window on the rows and columns of its model. The window follows the
/// cursor, and keeps the identity columns when it is scrolled sideways.
class ColumnTable {
public:
    TableModel& model() { return _model; }
    const TableModel& model() const { return _model; }

    /// The room on the screen, headings included.
    void setArea(int columns, int rows);
    /// The rows above and below the window.
    std::size_t rowsAbove() const { return _firstShown; }
    std::size_t rowsBelow() const;

    /// Moves the cursor by so many rows, stopping at the ends.
    void moveCursor(std::ptrdiff_t rows);
    void moveCursorTo(std::size_t shown);
    /// The height of the window less one row.
    std::ptrdiff_t page() const;
    /// Scrolls by so many columns of the table; false if it is already at that end.
    bool scrollSideways(int columns);
    /// Takes a key that chooses, sorts, hides or shows columns; false for other keys.
    bool handleColumnKey(char32_t character);
    /// Takes these keys, and those that move the cursor and scroll; false for other keys.
    bool handle(const KeyEvent& event);

    /// Draws headings and rows from row `top` on. A click on a row opens it.
    void draw(Grid& grid, const Marks& marks, HitMap& hits, int top,
              const std::function<void(std::size_t row)>& open);

private:
    /// What is known about a column from all of its cells.
    struct Measured {
        int width = 0; ///< of the widest cell
        bool isRight = false;
    };
    /// A column in the window.
    struct Place {
        std::size_t column;
        int x;
        int width;
        std::vector<std::string> heading;
        bool isWhole; ///< or as much as can be shown at all
    };
    struct Brush;

    void measure() const;
    std::vector<std::string> headingOf(std::size_t column) const;
    int widthOf(std::size_t column) const;
    /// The identity columns that are not scrolled: as many as leave room for others.
    std::size_t fixedColumns(const std::vector<std::size_t>& columns) const;
    std::vector<Place> places() const;
    /// Whether a column is wholly in the window.
    bool shows(std::size_t column) const;
    void revealChosen();
    int headingRows() const;
    std::size_t windowRows() const;
    void keepCursorInWindow();
    void drawHeadings(const Brush& brush, const std::vector<Place>& places, int top);
    void drawRow(const Brush& brush, const std::vector<Place>& places, std::size_t shown, int y);
    void drawCell(const Brush& brush, const Place& place, std::size_t row, int y, Style style);

    TableModel _model;
    int _columns = 0;
    int _rows = 0;
    std::size_t _firstShown = 0;
    std::size_t _firstColumn = 0; ///< of those that are scrolled
    mutable std::vector<Measured> _measured;
    mutable std::uint64_t _measuredVersion = 0; ///< of the content that was measured
};

} // namespace pallax::terminal
