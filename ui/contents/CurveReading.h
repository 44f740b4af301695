#pragma once

#include "timeline/Curve.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A length of time that curves can show.
struct CurveSpan {
    std::chrono::seconds length; ///< 0: all time
    std::string_view words;      ///< "the last 5 minutes"
};

/// From the shortest to all time.
std::span<const CurveSpan> curveSpans();

/// The time that curves show, and the cursor with which they are read. The cursor stays at its time
/// while the window moves.
class CurveReading {
public:
    /// Nothing: all time.
    std::optional<std::chrono::seconds> span() const;
    /// "the last 5 minutes".
    std::string_view spanWords() const { return curveSpans()[_chosen].words; }
    /// The index of the span among `curveSpans`.
    std::size_t chosen() const { return _chosen; }
    void choose(std::size_t span) { _chosen = span; }
    void zoomIn();
    void zoomOut();

    /// The curves of this window are shown in so many columns; none: there is no curve.
    void fit(Time from, Time to, int columns);
    bool hasCurve() const { return _columns > 0; }
    const std::optional<Time>& cursor() const { return _cursor; }
    /// Takes the cursor away.
    void leave() { _cursor.reset(); }
    // The functions that follow need a curve. The cursor appears in the last column.
    void back();
    void forward();
    void toFirst();
    void toLast();
    void moveTo(Time time);

    /// The words of what happened in the cursor's column.
    std::string wordsAtCursor(const std::vector<CurveEvent>& events) const;

private:
    std::int64_t columnOf(Time time) const;
    void moveToColumn(std::int64_t column);
    /// How much time a column stands for.
    std::chrono::nanoseconds step() const;

    std::size_t _chosen = 2; // 5 minutes
    std::optional<Time> _cursor;
    Time _from;
    Time _to;
    int _columns = 0;
};

} // namespace pallax
