#pragma once

#include "store/NamedRows.h"
#include "store/RecordingMeasurements.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <tuple>
#include <vector>

namespace pallax {

/// Keeps the intervals of a recording until there are many, and writes them in the order of their
/// series.
class IntervalWriter {
public:
    /// So many are written at once: a day at display ticks, and about 100 MB.
    static constexpr std::size_t kMostKept = std::size_t{1} << 20U;

    /// `measurements`, which names what the intervals are of, must outlive the writer. Times count
    /// from `first`.
    IntervalWriter(const RecordingMeasurements& measurements, Time first)
        : _measurements(measurements), _first(first) {}

    void add(const Interval& interval);
    bool isFull() const { return _rows.size() >= kMostKept; }
    /// The intervals that were added so far, also those that have been written.
    std::uint64_t count() const { return _count; }
    /// Writes those that are kept, within a transaction.
    void write(StoreConnection& store, std::int64_t recording, NamedRows& names);

private:
    struct Row {
        std::uint32_t series;
        Interval::Part part;
        std::int64_t time;
        std::int64_t hold;
        std::int64_t whole;
        std::uint64_t packet;
        FieldValue value;
    };
    struct Series {
        FieldIndex field = 0;
        EntryId entry = kNoEntry;
        std::optional<std::size_t> cell = {};
        std::string format = {}; ///< of its first number
        bool isReal = false;
    };

    void noteFormat(Series& series, const FieldValue& value);
    void write(const Row& row, const Series& series, NamedRows& names, Statement& add) const;
    void write(const Series& series, NamedRows& names, Statement& add) const;

    const RecordingMeasurements& _measurements;
    Time _first;
    std::uint64_t _count = 0;
    std::vector<Row> _rows;
    std::vector<Series> _series;
    std::map<std::tuple<FieldIndex, EntryId, std::optional<std::size_t>>, std::uint32_t> _places;
};

} // namespace pallax
