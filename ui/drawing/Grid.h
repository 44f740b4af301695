#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {

/// A colour that repeats what a text says: nothing is said by colour alone.
enum class Tint : std::uint8_t { None, Green, Blue, Orange, Red, Purple, Violet };
inline constexpr std::size_t kTints = 7;

/// The emphasis of a text. A terminal shows it as well as it can.
struct Style {
    bool bold = false;
    bool dim = false;
    bool underline = false;
    bool accent = false; ///< the one accent colour, for the current row; above a tint
    Tint tint = Tint::None;
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

/// A screen in memory: a terminal can show it, and tests compare it as text.
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
    /// Only for cells inside the grid.
    const Cell& at(int x, int y) const { return _cells[index(x, y)]; }

    /// Writes `text` from column `x` (which may be outside) of row `y`. Cuts off parts outside
    /// `clip` or the grid; half of a wide character becomes a blank. Returns the column after the
    /// whole text.
    int put(int x, int y, std::string_view text, Style style, Span clip);
    int put(int x, int y, std::string_view text, Style style = {}) {
        return put(x, y, text, style, {0, _columns});
    }
    /// Blanks a rectangle.
    void clear(int x, int y, int columns, int rows);
    /// Copies all cells of another grid to a place in this one, as far as there is room. Their
    /// right edge must not cut a wide character. The cursor stays where it is.
    void paste(const Grid& other, int x, int y);
    /// Repeats a text of one column.
    void fill(Span span, int y, std::string_view text, Style style = {});

    /// The position of the visible cursor; none at first.
    const std::optional<Position>& cursor() const { return _cursor; }
    void setCursor(Position position) { _cursor = position; }

    /// The rows as text, without trailing blanks.
    std::vector<std::string> lines() const;
    /// The rows as one text, each with a line end.
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
