#pragma once

#include "ui/drawing/Marks.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace pallax::terminal {

/// How many dots a character cell has in each direction.
struct DotsPerCell {
    int across;
    int down;
};
constexpr DotsPerCell dotsPerCell(Curves curves) {
    switch (curves) {
    case Curves::Braille:
        return {2, 4};
    case Curves::Blocks:
        return {1, 2};
    case Curves::Ascii:
        break;
    }
    return {1, 1};
}

/// A rectangle of character cells on which dots can be set.
class Dots {
public:
    /// Negative extents count as 0.
    Dots(int columns, int rows, Curves curves);

    int across() const { return _columns * _perCell.across; }
    int down() const { return _rows * _perCell.down; }
    /// Dots outside are left out.
    void set(int x, int y);
    void line(int fromX, int fromY, int toX, int toY);
    /// The character of a cell; empty if it has no dots. Only for cells inside.
    std::string textAt(int column, int row) const;

private:
    int _columns;
    int _rows;
    Curves _curves;
    DotsPerCell _perCell;
    std::vector<std::uint8_t> _cells; ///< a bit for each dot, row by row
};

} // namespace pallax::terminal
