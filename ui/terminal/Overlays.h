#pragma once

#include "platform/ui/Views.h"
#include "ui/terminal/Box.h"

#include <string>
#include <vector>

namespace pallax::terminal {

/// A box with the alert's title, message and its one button. Drawn over all else.
void drawAlert(Grid& grid, const Marks& marks, const ui::Alert& alert);

/// The help page's lines in so many columns of screen: every key and what it does, side by side or,
/// where that does not fit, the meaning below its keys.
std::vector<std::string> helpLines(int columns);

/// The help page from line `first` on, or from the last line at which it fills its box; how many
/// lines it shows at once is returned.
int drawHelp(Grid& grid, const Marks& marks, int first);

/// The least extent in which the screens can be drawn.
inline constexpr int kLeastColumns = 20;
inline constexpr int kLeastRows = 5;

/// Says which extent is needed, cut to what there is.
void drawTooSmall(Grid& grid);

} // namespace pallax::terminal
