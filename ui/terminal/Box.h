#pragma once

#include "ui/terminal/Grid.h"
#include "ui/terminal/Marks.h"

#include <string>
#include <string_view>

namespace pallax::terminal {

/// A framed area; the extents count the frame.
struct Box {
    /// What the frame takes of the rows, and of the columns.
    static constexpr int kFrame = 2;

    int x = 0;
    int y = 0;
    int columns = 0;
    int rows = 0;

    /// The columns between frame and one blank at either side.
    Span inside() const { return {x + 2, x + columns - 2}; }
};

/// A box of at most this extent in the middle of the grid.
Box centeredBox(const Grid& grid, int columns, int rows);

/// Blanks the box and draws its frame, with the title in the upper edge.
void drawBox(Grid& grid, const Marks& marks, const Box& box, std::string_view title);

/// A button's face: "[ Text ]", or "[Text]" where room is scarce.
std::string buttonFace(std::string_view text, bool isNarrow = false);

/// Draws a button ending before column `right`; where it begins is returned.
int drawButton(Grid& grid, int right, int y, std::string_view face, bool hasFocus);

} // namespace pallax::terminal
