#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {

/// How a text stands out. A terminal shows each as well as it can.
struct Style {
    bool bold = false;
    bool dim = false;
    bool underline = false;
    bool accent = false; ///< the one accent colour: where the user is
    bool operator==(const Style&) const = default;
};

/// Columns [left, right) of a row.
struct Span {
    int left = 0;
    int right = 0;
};

struct Position {
    int x = 0;
    int y = 0;
    bool operator==(const Position&) const = default;
};

/// A screen in memory: what is drawn on it can be shown by a terminal, or compared as text.
class Grid {
public:
    struct Cell {
        std::string text = " "; ///< empty in the right half of a wide character
        Style style;
        bool operator==(const Cell&) const = default;
    };

    /// Negative extents count as 0.
    Grid(int columns, int rows);

    int columns() const { return _columns; }
    int rows() const { return _rows; }
    /// Inside the grid only.
    const Cell& at(int x, int y) const { return _cells[index(x, y)]; }

    /// Writes `text` from column `x` (which may lie outside) of row `y`; what lies outside `clip`
    /// or the grid is cut off, and half of a wide character becomes a blank. Returns the column
    /// behind the text, cut or not.
    int put(int x, int y, std::string_view text, Style style, Span clip);
    int put(int x, int y, std::string_view text, Style style = {}) {
        return put(x, y, text, style, {0, _columns});
    }
    /// Blanks a rectangle.
    void clear(int x, int y, int columns, int rows);
    /// Repeats a text of one column.
    void fill(Span span, int y, std::string_view text, Style style = {});

    /// Where the terminal's cursor is seen; nowhere at first.
    const std::optional<Position>& cursor() const { return _cursor; }
    void setCursor(Position position) { _cursor = position; }

    /// The rows as text, without the blanks at their ends.
    std::vector<std::string> lines() const;
    /// The same in one piece, each row with its line end.
    std::string text() const;

private:
    std::size_t index(int x, int y) const {
        return static_cast<std::size_t>(y) * static_cast<std::size_t>(_columns) +
               static_cast<std::size_t>(x);
    }
    void set(int x, int y, std::string text, Style style);
    void separateWideCharacterAt(int x, int y);

    int _columns;
    int _rows;
    std::vector<Cell> _cells;
    std::optional<Position> _cursor;
};

} // namespace pallax::terminal
