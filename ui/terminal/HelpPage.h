#pragma once

#include "ui/terminal/Grid.h"
#include "ui/terminal/Keys.h"
#include "ui/terminal/Marks.h"

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
    int lastFirst() const;

    bool _isOpen = false;
    int _first = 0;
    int _rows = 0;  ///< rows that fit when last drawn
    int _lines = 0; ///< lines when last drawn
};

} // namespace pallax::terminal
