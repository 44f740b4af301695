#include "store/IntervalBatch.h"

#include "store/NumberText.h"

#include <algorithm>

namespace pallax {

namespace {

std::chrono::milliseconds wholeMilliseconds(Time time) {
    return std::chrono::floor<std::chrono::milliseconds>(time.time_since_epoch());
}

void noteFormat(IntervalBatch::Series& series, const FieldValue& value) {
    const DisplayNumber* shown = value.shown.displayNumber();
    if (series.format.empty() && shown != nullptr) {
        series.format = printfText(shown->format());
        series.isReal = shown->isReal();
    }
}

} // namespace

std::chrono::milliseconds IntervalBatch::first() const {
    return wholeMilliseconds(_first);
}

void IntervalBatch::add(const Interval& interval) {
    const auto [place, isNew] = _places.try_emplace({interval.field, interval.entry, interval.cell},
                                                    static_cast<std::uint32_t>(_series.size()));
    if (isNew) {
        _series.push_back({interval.field, interval.entry, interval.cell});
    }
    noteFormat(_series[place->second], interval.value);
    _rows.push_back({place->second, interval.part,
                     (wholeMilliseconds(interval.start) - first()).count(), interval.hold.count(),
                     interval.whole.count(), interval.packet, interval.value});
    ++_count;
}

std::span<const IntervalBatch::Row> IntervalBatch::sorted() {
    std::stable_sort(_rows.begin(), _rows.end(), [](const Row& one, const Row& other) {
        return one.series != other.series ? one.series < other.series : one.time < other.time;
    });
    return _rows;
}

void IntervalBatch::clear() {
    _rows.clear();
    _series.clear();
    _places.clear();
}

} // namespace pallax
