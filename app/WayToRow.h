#pragma once

#include <cstddef>
#include <functional>
#include <vector>

namespace pallax {

namespace ui {
class NavigationStack;
} // namespace ui

/// Opens the panes on the way to a row of the display, except those that are open. `place` is the
/// row in each pane on the way, beginning with the root's, and not empty; `select` moves the cursor
/// of the topmost pane.
void openWay(ui::NavigationStack& panes, const std::vector<std::size_t>& place,
             const std::function<void(std::size_t row)>& select);

/// The place of a row of the topmost pane, as `openWay` takes it.
std::vector<std::size_t> placeOf(const ui::NavigationStack& panes, std::size_t row);

} // namespace pallax
