#pragma once

#include "ui/drawing/Bars.h"
#include "ui/drawing/Scrolling.h"

#include <algorithm>
#include <string_view>
#include <vector>

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

/// The rows around a page's content: its title, the rules, and the last row.
class PageFrame {
public:
    /// Draws the title.
    PageFrame(const PageScreen& screen, const PageSurroundings& around, std::string_view title);

    /// The rows of the content, from kRowsAbove on, and its columns.
    int rows() const { return std::max(_screen.grid.rows() - kRowsAbove - kRowsBelow, 0); }
    Span span() const { return {kMargin, _screen.grid.columns() - kMargin}; }
    /// Draws the rules, with the number of lines of `lines` that are hidden, and the last row.
    void finish(const Scrolling& scrolling, int lines, const std::vector<Hint>& hints) const;

private:
    PageScreen _screen;
    const PageSurroundings& _around;
};

/// Whether a key goes back, as in a pane that is not scrolled sideways.
bool goesBack(const KeyEvent& event);

} // namespace pallax::terminal
