#include "ui/drawing/Box.h"

#include "ui/drawing/TextWidth.h"

#include <algorithm>

namespace pallax::terminal {

Box centeredBox(const Grid& grid, int columns, int rows) {
    Box box;
    box.columns = std::min(columns, grid.columns());
    box.rows = std::min(rows, grid.rows());
    box.x = (grid.columns() - box.columns) / 2;
    box.y = (grid.rows() - box.rows) / 2;
    return box;
}

void drawBox(Grid& grid, const Marks& marks, const Box& box, std::string_view title) {
    grid.clear(box.x, box.y, box.columns, box.rows);
    const int right = box.x + box.columns - 1;
    const int bottom = box.y + box.rows - 1;
    grid.fill({box.x, right}, box.y, marks.horizontal);
    grid.fill({box.x, right}, bottom, marks.horizontal);
    for (int y = box.y + 1; y < bottom; ++y) {
        grid.put(box.x, y, marks.vertical);
        grid.put(right, y, marks.vertical);
    }
    grid.put(box.x, box.y, marks.topLeft);
    grid.put(right, box.y, marks.topRight);
    grid.put(box.x, bottom, marks.bottomLeft);
    grid.put(right, bottom, marks.bottomRight);
    if (!title.empty()) {
        const Span edge{box.x + 1, right};
        const int start = grid.put(box.x + 1, box.y, " ", {}, edge);
        const int end = grid.put(start, box.y, title, {.bold = true}, edge);
        grid.put(end, box.y, " ", {}, edge);
    }
}

std::string buttonFace(std::string_view text, bool isNarrow) {
    const std::string_view blank = isNarrow ? "" : " ";
    return std::string("[").append(blank).append(text).append(blank).append("]");
}

int drawButton(Grid& grid, int right, int y, std::string_view face, bool hasFocus) {
    const int left = right - columnsOf(face);
    // Bold and underlined too, so that the focus is visible without colours.
    grid.put(left, y, face, {.bold = hasFocus, .underline = hasFocus, .accent = hasFocus});
    return left;
}

} // namespace pallax::terminal
