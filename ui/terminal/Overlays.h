#pragma once

#include "platform/ui/Views.h"
#include "ui/terminal/Box.h"

#include <string_view>
#include <vector>

namespace pallax::terminal {

/// A box with the alert's title, message and its one button. Drawn over all else.
void drawAlert(Grid& grid, const Marks& marks, const ui::Alert& alert);

/// The help page's lines: every key and what it does.
const std::vector<std::string_view>& helpLines();

/// The help page from line `first` on, or from the last line at which it fills its box; how many
/// lines it shows at once is returned.
int drawHelp(Grid& grid, const Marks& marks, int first);

/// The least extent in which the screens can be drawn.
inline constexpr int kLeastColumns = 20;
inline constexpr int kLeastRows = 5;

/// Says which extent is needed, cut to what there is.
void drawTooSmall(Grid& grid);

} // namespace pallax::terminal
