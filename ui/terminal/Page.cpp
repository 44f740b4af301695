#include "ui/terminal/Page.h"

namespace pallax::terminal {

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
