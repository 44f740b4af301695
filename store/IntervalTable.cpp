#include "store/IntervalTable.h"

#include "text/NumberFormat.h"

#include <algorithm>
#include <cmath>
#include <span>

namespace pallax {

namespace {

/// Levels come in halves, quarters or sixteenths of a decibel.
constexpr double kStepsOfReal = 16;

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

void writeRow(const IntervalBatch::Row& row, const IntervalBatch::Series& series,
              const FieldInfo& field, NamedRows& names, Statement& add) {
    add.bind(2, row.time).bind(3, row.hold);
    bindNumber(add, 4, row.value, series.isReal);
    add.bind(5, names.text(field, row.value, series.format));
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

void writeSeries(const IntervalBatch::Series& series, const RecordingMeasurements& measurements,
                 NamedRows& names, Statement& add) {
    add.bind(2, names.field(measurements.fields()[series.field]));
    add.bind(3, series.entry != kNoEntry ? std::optional(measurements.entries().words(series.entry))
                                         : std::nullopt);
    add.bind(4, series.cell ? std::optional(names.site(measurements.cells()[*series.cell]))
                            : std::nullopt);
    if (series.isReal) {
        add.bind(5, 1 / kStepsOfReal);
    } else {
        add.bind(5, std::int64_t{1});
    }
    add.bind(6, series.format).run();
}

} // namespace

void writeIntervals(IntervalBatch& batch, StoreConnection& store, std::int64_t recording,
                    NamedRows& names) {
    const auto sorted = batch.sorted();
    IntervalRows rows(store);
    Statement addSeries = store.prepare(
        "INSERT INTO series (recording, field, entry, site, step, format, first_row, last_row, "
        "first, last) VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?, ?)");
    addSeries.bind(1, recording);
    for (auto from = sorted.begin(); from != sorted.end();) {
        const auto to = std::find_if(from, sorted.end(),
                                     [&](const auto& row) { return row.series != from->series; });
        const IntervalBatch::Series& series = batch.series(*from);
        const FieldInfo& field = batch.measurements().fields()[series.field];
        addSeries.bind(7, rows.last() + 1);
        std::int64_t end = 0;
        for (const auto& row : std::span(from, to)) {
            writeRow(row, series, field, names, rows.next());
            end = std::max(end, row.time + row.hold);
        }
        addSeries.bind(8, rows.last()).bind(9, from->time).bind(10, end);
        writeSeries(series, batch.measurements(), names, addSeries);
        from = to;
    }
    batch.clear();
}

} // namespace pallax
