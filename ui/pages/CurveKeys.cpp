#include "ui/pages/CurveKeys.h"

namespace pallax::terminal {

namespace {

/// The letters of the arrows, as in panes.
Key arrowOf(const KeyEvent& event) {
    if (event.key == Key::Character && event.character == U'h') {
        return Key::Left;
    }
    return event.key == Key::Character && event.character == U'l' ? Key::Right : event.key;
}

} // namespace

bool handleCurveKey(CurveReading& reading, const KeyEvent& event) {
    if (!reading.hasCurve()) {
        return false;
    }
    if (event.key == Key::Character && (event.character == U'+' || event.character == U'=')) {
        reading.zoomIn();
        return true;
    }
    if (event.key == Key::Character && event.character == U'-') {
        reading.zoomOut();
        return true;
    }
    switch (arrowOf(event)) {
    case Key::Left:
        reading.back();
        return true;
    case Key::Right:
        reading.forward();
        return true;
    case Key::Home:
        reading.toFirst();
        return true;
    case Key::End:
        reading.toLast();
        return true;
    default:
        return false;
    }
}

} // namespace pallax::terminal
