#pragma once

#include "ui/drawing/Keys.h"
#include "ui/drawing/Plot.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>

namespace pallax::terminal {

/// The time that curves show, and the cursor with which they are read, as keys set them.
class CurveKeys {
public:
    /// Nothing: all time.
    std::optional<std::chrono::seconds> span() const;
    /// "the last 5 minutes".
    std::string_view spanWords() const;
    const std::optional<Time>& cursor() const { return _cursor; }

    /// Zooms or moves the cursor; false for a key that does not, and for all if no curve is shown.
    bool handle(const KeyEvent& event);
    /// The curves of this window are shown in so many columns; none: there is no curve.
    void fit(Time from, Time to, int columns);
    /// The words of what happened in the cursor's column.
    std::string wordsAtCursor(const std::vector<PlotEvent>& events) const;

private:
    std::int64_t columnOf(Time time) const;
    void moveTo(std::int64_t column);
    /// How much time a column stands for.
    std::chrono::nanoseconds step() const;

    std::size_t _zoom = 2; // 5 minutes
    std::optional<Time> _cursor;
    Time _from;
    Time _to;
    int _columns = 0;
};

} // namespace pallax::terminal
