#pragma once

#include "ui/terminal/Bars.h"
#include "ui/terminal/OverviewText.h"
#include "ui/terminal/Scrolling.h"

#include <string_view>

namespace pallax::terminal {

/// The overview: a screen over the panes, which are updated while it is open.
class OverviewPage {
public:
    struct Screen {
        Grid& grid;
        const Marks& marks;
        HitMap& hits;
    };
    /// What is shown around the overview.
    struct Around {
        std::string_view root; ///< the first pane's title
        const ui::BarItems& items;
        const PaneStatus& status;
    };

    bool isOpen() const { return _isOpen; }
    void open();
    void close() { _isOpen = false; }
    /// Closes the page or scrolls it; false for a key that does neither.
    bool handle(const KeyEvent& event);
    void draw(const Screen& screen, const Overview& overview, const Around& around);

private:
    bool _isOpen = false;
    Scrolling _scrolling;
};

} // namespace pallax::terminal
