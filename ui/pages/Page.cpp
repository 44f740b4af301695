#include "ui/pages/Page.h"

#include "ui/pages/PageTitle.h"

#include <string>

namespace pallax::terminal {

PageFrame::PageFrame(const PageScreen& screen, const PageSurroundings& around,
                     std::string_view title)
    : _screen(screen), _around(around) {
    Bars bars(screen.grid, screen.marks, screen.hits, around.status);
    drawPageTitle(screen.grid, screen.marks, bars,
                  std::string(around.root).append(screen.marks.crumb).append(title));
}

void PageFrame::finish(const Scrolling& scrolling, int lines,
                       const std::vector<Hint>& hints) const {
    Bars bars(_screen.grid, _screen.marks, _screen.hits, _around.status);
    (void)bars.drawRule(kRowsAbove - 1, _screen.marks.up,
                        static_cast<std::size_t>(scrolling.first()), Key::PageUp);
    const int below = std::max(lines - scrolling.first() - rows(), 0);
    const int ruleRight = bars.drawRule(_screen.grid.rows() - kRowsBelow, _screen.marks.down,
                                        static_cast<std::size_t>(below), Key::PageDown);
    bars.drawLastRow(_around.items, ruleRight, hints);
}

bool goesBack(const KeyEvent& event) {
    switch (event.key) {
    case Key::Escape:
    case Key::Left:
    case Key::Backspace:
        return true;
    default:
        return event.key == Key::Character && event.character == U'h';
    }
}

} // namespace pallax::terminal
