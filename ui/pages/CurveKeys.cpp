#include "ui/pages/CurveKeys.h"

#include <algorithm>
#include <array>

namespace pallax::terminal {

namespace {

struct CurveSpan {
    int seconds; ///< 0: all
    std::string_view words;
};

constexpr std::array kCurveSpans{
    CurveSpan{30, "the last 30 seconds"}, CurveSpan{60, "the last minute"},
    CurveSpan{300, "the last 5 minutes"}, CurveSpan{900, "the last 15 minutes"},
    CurveSpan{3600, "the last hour"},     CurveSpan{0, "all time"},
};

/// The letters of the arrows, as in panes.
Key arrowOf(const KeyEvent& event) {
    if (event.key == Key::Character && event.character == U'h') {
        return Key::Left;
    }
    return event.key == Key::Character && event.character == U'l' ? Key::Right : event.key;
}

} // namespace

std::optional<std::chrono::seconds> CurveKeys::span() const {
    const int seconds = kCurveSpans.at(_zoom).seconds;
    return seconds != 0 ? std::optional(std::chrono::seconds(seconds)) : std::nullopt;
}

std::string_view CurveKeys::spanWords() const {
    return kCurveSpans.at(_zoom).words;
}

void CurveKeys::fit(Time from, Time to, int columns) {
    _from = from;
    _to = to;
    _columns = from < to ? std::max(columns, 0) : 0;
    if (_columns == 0) {
        _cursor.reset();
    } else if (_cursor) {
        _cursor = std::clamp(*_cursor, _from, _to);
    }
}

std::chrono::nanoseconds CurveKeys::step() const {
    return (_to - _from) / std::max(_columns, 1);
}

std::int64_t CurveKeys::columnOf(Time time) const {
    const auto step = std::max(this->step(), std::chrono::nanoseconds(1));
    return std::clamp<std::int64_t>((time - _from) / step, 0, _columns - 1);
}

/// The cursor is in the middle of its column.
void CurveKeys::moveTo(std::int64_t column) {
    const std::int64_t inside = std::clamp<std::int64_t>(column, 0, _columns - 1);
    _cursor = _from + inside * step() + step() / 2;
}

bool CurveKeys::handle(const KeyEvent& event) {
    if (_columns == 0) {
        return false;
    }
    if (event.key == Key::Character && (event.character == U'+' || event.character == U'=')) {
        _zoom -= _zoom > 0 ? 1 : 0;
        return true;
    }
    if (event.key == Key::Character && event.character == U'-') {
        _zoom += _zoom + 1 < kCurveSpans.size() ? 1 : 0;
        return true;
    }
    switch (arrowOf(event)) {
    case Key::Left:
        moveTo(_cursor ? columnOf(*_cursor) - 1 : _columns - 1);
        return true;
    case Key::Right:
        moveTo(_cursor ? columnOf(*_cursor) + 1 : _columns - 1);
        return true;
    case Key::Home:
        moveTo(0);
        return true;
    case Key::End:
        moveTo(_columns - 1);
        return true;
    default:
        return false;
    }
}

std::string CurveKeys::wordsAtCursor(const std::vector<PlotEvent>& events) const {
    std::string words;
    if (!_cursor || _columns == 0) {
        return words;
    }
    for (const PlotEvent& event : events) {
        if (columnOf(event.time) == columnOf(*_cursor)) {
            words.append(words.empty() ? "" : "; ").append(event.words);
        }
    }
    return words;
}

} // namespace pallax::terminal
