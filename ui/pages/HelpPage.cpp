#include "ui/pages/HelpPage.h"

#include "ui/pages/Overlays.h"

namespace pallax::terminal {

void HelpPage::open(HelpPlace place) {
    _isOpen = true;
    _place = place;
    _scrolling = {};
}

void HelpPage::handle(const KeyEvent& event) {
    if (_place && event.key == Key::Character && event.character == U'?') {
        _place.reset();
        _scrolling = {};
    } else {
        _isOpen = _scrolling.handle(event);
    }
}

void HelpPage::draw(Grid& grid, const Marks& marks) {
    const int rows = drawHelp(grid, marks, _scrolling.first(), _place);
    _scrolling.fit(rows, static_cast<int>(helpLines(grid.columns(), _place).size()));
}

} // namespace pallax::terminal
