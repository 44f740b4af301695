#include "ui/terminal/HelpPage.h"

#include "ui/terminal/Overlays.h"

namespace pallax::terminal {

void HelpPage::open() {
    _isOpen = true;
    _scrolling = {};
}

void HelpPage::handle(const KeyEvent& event) {
    _isOpen = _scrolling.handle(event);
}

void HelpPage::draw(Grid& grid, const Marks& marks) {
    const int rows = drawHelp(grid, marks, _scrolling.first());
    _scrolling.fit(rows, static_cast<int>(helpLines(grid.columns()).size()));
}

} // namespace pallax::terminal
