#pragma once

#include "ui/drawing/Bars.h"

#include <string_view>

namespace pallax::terminal {

class LineEditor;

/// Draws a line that is being typed in the last row, after a mark such as "/", with the text
/// cursor, and a hint on the right if there is room.
void drawPrompt(Grid& grid, Bars& bars, std::string_view mark, const LineEditor& editor,
                const Hint& hint);

} // namespace pallax::terminal
