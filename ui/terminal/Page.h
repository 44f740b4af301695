#pragma once

#include "ui/terminal/Bars.h"

#include <string_view>

namespace pallax::terminal {

/// What a page makes of a key.
enum class PageAnswer {
    Handled,
    Closes,  ///< the key closes the page
    NotMine, ///< the front end may know the key
};

/// What pages draw on.
struct PageScreen {
    Grid& grid;
    const Marks& marks;
    HitMap& hits;
};

/// What is shown around the content of a page.
struct PageSurroundings {
    std::string_view root; ///< the first pane's title
    const ui::BarItems& items;
    const PaneStatus& status;
};

/// Whether a key goes back, as in a pane that is not scrolled sideways.
bool goesBack(const KeyEvent& event);

} // namespace pallax::terminal
