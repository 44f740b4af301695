#pragma once

#include "ui/terminal/Grid.h"
#include "ui/terminal/Keys.h"
#include "ui/terminal/Marks.h"
#include "ui/terminal/Scrolling.h"

namespace pallax::terminal {

/// The open help page and its scroll position.
class HelpPage {
public:
    bool isOpen() const { return _isOpen; }
    void open();
    /// Scrolls if the page does not fit; any other key closes the page.
    void handle(const KeyEvent& event);
    void draw(Grid& grid, const Marks& marks);

private:
    bool _isOpen = false;
    Scrolling _scrolling;
};

} // namespace pallax::terminal
