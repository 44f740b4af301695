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
        : _add(store.prepare("INSERT INTO intervals (id, time, hold, number, text, packet, "
                             "whole) VALUES (?, ?, ?, ?, ?, ?, ?)")) {
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
    const auto [place, isNew] = _places.try_emplace({interval.field, interval.entry, interval.cell},
                                                    static_cast<std::uint32_t>(_series.size()));
    if (isNew) {
        _series.push_back({interval.field, interval.entry, interval.cell});
    }
    noteFormat(_series[place->second], interval.value);
    _rows.push_back({place->second, interval.part, millisecondsSince(_first, interval.start),
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
        "INSERT INTO series (recording, field, entry, site, step, format, first_row, last_row, "
        "first, last) VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?, ?)");
    addSeries.bind(1, recording);
    for (auto from = _rows.begin(); from != _rows.end();) {
        const auto to = std::find_if(from, _rows.end(),
                                     [&](const Row& row) { return row.series != from->series; });
        const Series& series = _series[from->series];
        addSeries.bind(7, rows.last() + 1);
        std::int64_t end = 0;
        for (const Row& row : std::span(from, to)) {
            write(row, series, names, rows.next());
            end = std::max(end, row.time + row.hold);
        }
        addSeries.bind(8, rows.last()).bind(9, from->time).bind(10, end);
        write(series, names, addSeries);
        from = to;
    }
    _rows.clear();
    _series.clear();
    _places.clear();
}

void IntervalWriter::write(const Row& row, const Series& series, NamedRows& names,
                           Statement& add) const {
    add.bind(2, row.time).bind(3, row.hold);
    bindNumber(add, 4, row.value, series.isReal);
    add.bind(5, names.text(_measurements.fields()[series.field], row.value, series.format));
    add.bind(6, static_cast<std::int64_t>(row.packet));
    switch (row.part) {
    case Interval::Part::Whole:
        add.bindNull(7);
        break;
    case Interval::Part::First:
        add.bind(7, row.whole);
        break;
    case Interval::Part::Continued:
        add.bind(7, std::int64_t{-1});
        break;
    }
    add.run();
}

void IntervalWriter::write(const Series& series, NamedRows& names, Statement& add) const {
    const FieldInfo& info = _measurements.fields()[series.field];
    add.bind(2, names.field(info));
    add.bind(3, series.entry != kNoEntry
                    ? std::optional(_measurements.entries().words(series.entry))
                    : std::nullopt);
    add.bind(4, series.cell ? std::optional(names.site(_measurements.cells()[*series.cell]))
                            : std::nullopt);
    if (series.isReal) {
        add.bind(5, 1 / kStepsOfReal);
    } else {
        add.bind(5, std::int64_t{1});
    }
    add.bind(6, series.format).run();
}

} // namespace pallax
