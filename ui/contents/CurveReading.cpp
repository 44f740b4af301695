#include "ui/contents/CurveReading.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

using std::chrono::seconds;

constexpr std::array kCurveSpans{
    CurveSpan{seconds(30), "the last 30 seconds"}, CurveSpan{seconds(60), "the last minute"},
    CurveSpan{seconds(300), "the last 5 minutes"}, CurveSpan{seconds(900), "the last 15 minutes"},
    CurveSpan{seconds(3600), "the last hour"},     CurveSpan{seconds(0), "all time"},
};

} // namespace

std::span<const CurveSpan> curveSpans() {
    return kCurveSpans;
}

std::optional<seconds> CurveReading::span() const {
    const seconds length = kCurveSpans.at(_chosen).length;
    return length != seconds(0) ? std::optional(length) : std::nullopt;
}

void CurveReading::zoomIn() {
    _chosen -= _chosen > 0 ? 1 : 0;
}

void CurveReading::zoomOut() {
    _chosen += _chosen + 1 < kCurveSpans.size() ? 1 : 0;
}

void CurveReading::fit(Time from, Time to, int columns) {
    _from = from;
    _to = to;
    _columns = from < to ? std::max(columns, 0) : 0;
    if (_columns == 0) {
        _cursor.reset();
    } else if (_cursor) {
        _cursor = std::clamp(*_cursor, _from, _to);
    }
}

std::chrono::nanoseconds CurveReading::step() const {
    return (_to - _from) / std::max(_columns, 1);
}

std::int64_t CurveReading::columnOf(Time time) const {
    const auto step = std::max(this->step(), std::chrono::nanoseconds(1));
    return std::clamp<std::int64_t>((time - _from) / step, 0, _columns - 1);
}

/// The cursor is in the middle of its column.
void CurveReading::moveToColumn(std::int64_t column) {
    const std::int64_t inside = std::clamp<std::int64_t>(column, 0, _columns - 1);
    _cursor = _from + inside * step() + step() / 2;
}

void CurveReading::back() {
    moveToColumn(_cursor ? columnOf(*_cursor) - 1 : _columns - 1);
}

void CurveReading::forward() {
    moveToColumn(_cursor ? columnOf(*_cursor) + 1 : _columns - 1);
}

void CurveReading::toFirst() {
    moveToColumn(0);
}

void CurveReading::toLast() {
    moveToColumn(_columns - 1);
}

void CurveReading::moveTo(Time time) {
    moveToColumn(columnOf(time));
}

std::string CurveReading::wordsAtCursor(const std::vector<CurveEvent>& events) const {
    std::string words;
    if (!_cursor || _columns == 0) {
        return words;
    }
    for (const CurveEvent& event : events) {
        if (columnOf(event.time) == columnOf(*_cursor)) {
            words.append(words.empty() ? "" : "; ").append(event.words);
        }
    }
    return words;
}

} // namespace pallax
