#pragma once

#include "platform/ui/Views.h"
#include "ui/drawing/Box.h"
#include "ui/pages/KeyHelp.h"

#include <optional>
#include <string>
#include <vector>

namespace pallax::terminal {

/// Draws a box with the alert's title, message and button over everything else.
void drawAlert(Grid& grid, const Marks& marks, const ui::Alert& alert);

/// The lines of the help page for a screen of this width: each key with its meaning next to it, or
/// below it if that does not fit. Only those that work in `place`, or all.
std::vector<std::string> helpLines(int columns, std::optional<HelpPlace> place = {});

/// Draws the help page from line `first`, or from the last line at which it fills its box. Returns
/// how many lines fit at once.
int drawHelp(Grid& grid, const Marks& marks, int first, std::optional<HelpPlace> place = {});

/// The smallest extent in which the screens can be drawn.
inline constexpr int kLeastColumns = 20;
inline constexpr int kLeastRows = 5;

/// Shows the required extent, cut to the grid.
void drawTooSmall(Grid& grid);

} // namespace pallax::terminal
