#pragma once

#include "ui/drawing/Bars.h"

#include <string>
#include <string_view>

namespace pallax::terminal {

/// The title of a page and, where there is room, the origin of the values. A title that does not
/// fit is cut at its beginning.
void drawPageTitle(Grid& grid, const Marks& marks, Bars& bars, std::string_view title);

} // namespace pallax::terminal
