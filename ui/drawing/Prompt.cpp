#include "ui/drawing/Prompt.h"

#include "ui/drawing/LineEditor.h"
#include "ui/drawing/TextWidth.h"

#include <algorithm>

namespace pallax::terminal {

void drawPrompt(Grid& grid, Bars& bars, std::string_view mark, const LineEditor& editor,
                const Hint& hint) {
    const int y = grid.rows() - 1;
    const int start = kMargin + columnsOf(mark) + 1;
    const int cursor = columnsOf(std::string_view(editor.text()).substr(0, editor.cursor()));
    const int last = grid.columns() - 1 - kMargin;
    // A long text is scrolled so that the cursor stays visible.
    const int offset = std::max(start + cursor - last, 0);
    grid.put(kMargin, y, mark, {.bold = true});
    const int end = grid.put(start - offset, y, editor.text(), {}, {start, last});
    grid.setCursor({start + cursor - offset, y});
    const int left = grid.columns() - kMargin - columnsOf(hint.text);
    if (left > end + 1) {
        bars.drawHint(left, hint.text, hint.key);
    }
}

} // namespace pallax::terminal
