#pragma once

#include "ui/terminal/Grid.h"
#include "ui/terminal/Keys.h"
#include "ui/terminal/Marks.h"

namespace pallax::terminal {

/// The help page while it is open, and which part of it is seen.
class HelpPage {
public:
    bool isOpen() const { return _isOpen; }
    void open();
    /// Scrolls where the page does not fit; any key that does not scroll closes it.
    void handle(const KeyEvent& event);
    void draw(Grid& grid, const Marks& marks);

private:
    int lastFirst() const;

    bool _isOpen = false;
    int _first = 0;
    int _rows = 0;  ///< that fitted at the last drawing
    int _lines = 0; ///< that there were then
};

} // namespace pallax::terminal
