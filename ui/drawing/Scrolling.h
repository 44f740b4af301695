#pragma once

#include "ui/drawing/Keys.h"

namespace pallax::terminal {

/// The position of a window on lines that are only read.
class Scrolling {
public:
    /// Scrolls; false for a key that does not.
    bool handle(const KeyEvent& event);
    /// The window shows `rows` of `lines` lines.
    void fit(int rows, int lines);
    /// The first line in the window.
    int first() const { return _first; }

private:
    /// The first line when the window is at the end.
    int lastFirst() const;

    int _first = 0;
    int _rows = 0;
    int _lines = 0;
};

} // namespace pallax::terminal
