#pragma once

#include "ui/drawing/Grid.h"
#include "ui/drawing/Marks.h"

#include <string>
#include <string_view>

namespace pallax::terminal {

/// A framed area; its extents include the frame.
struct Box {
    /// Rows and columns of the frame, both sides together.
    static constexpr int kFrame = 2;

    int x = 0;
    int y = 0;
    int columns = 0;
    int rows = 0;

    /// The columns inside the frame and one blank on each side.
    Span inside() const { return {x + 2, x + columns - 2}; }
};

/// A box of at most this extent in the middle of the grid.
Box centeredBox(const Grid& grid, int columns, int rows);

/// Blanks the box and draws its frame, with the title in the upper edge.
void drawBox(Grid& grid, const Marks& marks, const Box& box, std::string_view title);

/// A button's text: "[ Text ]", or "[Text]" if `isNarrow`.
std::string buttonFace(std::string_view text, bool isNarrow = false);

/// Draws a button that ends before column `right`; returns its first column.
int drawButton(Grid& grid, int right, int y, std::string_view face, bool hasFocus);

} // namespace pallax::terminal
