#include "ui/drawing/Scrolling.h"

#include <algorithm>
#include <optional>

namespace pallax::terminal {

namespace {

/// How many lines a key scrolls a page of `lines` lines that shows `rows` of them; nothing for any
/// other key.
std::optional<int> scrolledLines(const KeyEvent& event, int rows, int lines) {
    constexpr int kWheelLines = 3;
    switch (event.key) {
    case Key::Up:
        return -1;
    case Key::Down:
        return 1;
    case Key::PageUp:
        return -rows;
    case Key::PageDown:
        return rows;
    case Key::Home:
        return -lines;
    case Key::End:
        return lines;
    case Key::WheelUp:
        return -kWheelLines;
    case Key::WheelDown:
        return kWheelLines;
    default:
        return std::nullopt;
    }
}

/// Replaces the letters that act as keys.
KeyEvent withoutLetters(const KeyEvent& event) {
    if (event.key != Key::Character) {
        return event;
    }
    switch (event.character) {
    case U'k':
        return {.key = Key::Up};
    case U'j':
        return {.key = Key::Down};
    case U'g':
        return {.key = Key::Home};
    case U'G':
        return {.key = Key::End};
    default:
        return event;
    }
}

} // namespace

bool Scrolling::handle(const KeyEvent& event) {
    const auto lines = scrolledLines(withoutLetters(event), _rows, _lines);
    _first = std::clamp(_first + lines.value_or(0), 0, lastFirst());
    return lines.has_value();
}

void Scrolling::fit(int rows, int lines) {
    _rows = rows;
    _lines = lines;
    _first = std::min(_first, lastFirst()); // the window may have grown
}

int Scrolling::lastFirst() const {
    return std::max(_lines - _rows, 0);
}

} // namespace pallax::terminal
