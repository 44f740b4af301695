#pragma once

#include "ui/drawing/Grid.h"

#include <string_view>

namespace pallax::terminal {

/// Writes a text as `Grid::put` does, and underlines the first part that matches the filter.
int putMarked(Grid& grid, Position position, std::string_view text, Style style, Span clip,
              std::string_view filter);

} // namespace pallax::terminal
