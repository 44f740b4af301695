#include "store/IntervalWriter.h"

#include "store/NumberText.h"
#include "text/NumberFormat.h"

#include <algorithm>
#include <cmath>
#include <span>

namespace pallax {

namespace {

/// Levels come in halves, quarters or sixteenths of a decibel.
constexpr double kStepsOfReal = 16;

std::int64_t millisecondsSince(Time first, Time time) {
    using std::chrono::floor;
    using std::chrono::milliseconds;
    return (floor<milliseconds>(time) - floor<milliseconds>(first)).count();
}

/// A number as the table has it; see `series.step`.
void bindNumber(Statement& statement, int parameter, const FieldValue& value, bool isReal) {
    const DisplayNumber* shown = value.shown.displayNumber();
    if (std::isnan(value.number)) {
        statement.bindNull(parameter);
    } else if (shown != nullptr && !shown->isReal() && !isReal) {
        statement.bind(parameter, shown->integer());
    } else {
        constexpr double kMostSteps = 9e15; // all whole numbers up to it are numbers of a double
        const double steps = value.number * kStepsOfReal;
        if (isReal && steps == std::floor(steps) && std::abs(steps) < kMostSteps) {
            statement.bind(parameter, static_cast<std::int64_t>(steps));
        } else {
            statement.bind(parameter, value.number);
        }
    }
}

/// Writes the rows of one table, whose numbers continue.
class IntervalRows {
public:
    explicit IntervalRows(StoreConnection& store)
        : _add(store.prepare("INSERT INTO intervals (id, time, hold, number, site, text, packet, "
                             "whole) VALUES (?, ?, ?, ?, ?, ?, ?, ?)")) {
        Statement last = store.prepare("SELECT coalesce(max(id), 0) FROM intervals");
        last.step();
        _last = last.integer(0);
    }

    std::int64_t last() const { return _last; }
    Statement& next() {
        _add.bind(1, ++_last);
        return _add;
    }

private:
    Statement _add;
    std::int64_t _last = 0;
};

} // namespace

void IntervalWriter::add(const Interval& interval) {
    constexpr unsigned kHalf = 32;
    const std::uint64_t key = std::uint64_t{interval.field} << kHalf | interval.entry;
    const auto [place, isNew] =
        _places.try_emplace(key, static_cast<std::uint32_t>(_series.size()));
    if (isNew) {
        _series.push_back({interval.field, interval.entry});
    }
    noteFormat(_series[place->second], interval.value);
    const auto cell = interval.cell ? static_cast<std::int64_t>(*interval.cell) : -1;
    _rows.push_back({place->second, interval.part, cell, millisecondsSince(_first, interval.start),
                     interval.hold.count(), interval.whole.count(), interval.packet,
                     interval.value});
    ++_count;
}

void IntervalWriter::noteFormat(Series& series, const FieldValue& value) {
    const DisplayNumber* shown = value.shown.displayNumber();
    if (series.format.empty() && shown != nullptr) {
        series.format = printfText(shown->format());
        series.isReal = shown->isReal();
    }
}

void IntervalWriter::write(StoreConnection& store, std::int64_t recording, NamedRows& names) {
    std::stable_sort(_rows.begin(), _rows.end(), [](const Row& one, const Row& other) {
        return one.series != other.series ? one.series < other.series : one.time < other.time;
    });
    IntervalRows rows(store);
    Statement addSeries = store.prepare(
        "INSERT INTO series (recording, field, entry, step, format, first_row, last_row, first, "
        "last) VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?)");
    for (auto from = _rows.begin(); from != _rows.end();) {
        const auto to = std::find_if(from, _rows.end(),
                                     [&](const Row& row) { return row.series != from->series; });
        const Series& series = _series[from->series];
        const FieldInfo& info = _measurements.fields()[series.field];
        const std::int64_t first = rows.last() + 1;
        std::int64_t end = 0;
        for (const Row& row : std::span(from, to)) {
            Statement& add = rows.next();
            add.bind(2, row.time).bind(3, row.hold);
            bindNumber(add, 4, row.value, series.isReal);
            add.bind(5, row.cell >= 0
                            ? std::optional(names.site(
                                  _measurements.cells()[static_cast<std::size_t>(row.cell)]))
                            : std::nullopt);
            add.bind(6, names.text(info, row.value, series.format));
            add.bind(7, static_cast<std::int64_t>(row.packet));
            add.bind(8, row.part == Interval::Part::Whole   ? std::nullopt
                        : row.part == Interval::Part::First ? std::optional(row.whole)
                                                            : std::optional<std::int64_t>(-1));
            add.run();
            end = std::max(end, row.time + row.hold);
        }
        addSeries.bind(1, recording).bind(2, names.field(info));
        addSeries.bind(3, series.entry != kNoEntry
                              ? std::optional(_measurements.entries().words(series.entry))
                              : std::nullopt);
        if (series.isReal) {
            addSeries.bind(4, 1 / kStepsOfReal);
        } else {
            addSeries.bind(4, std::int64_t{1});
        }
        addSeries.bind(5, series.format).bind(6, first).bind(7, rows.last());
        addSeries.bind(8, from->time).bind(9, end).run();
        from = to;
    }
    _rows.clear();
    _series.clear();
    _places.clear();
}

} // namespace pallax
