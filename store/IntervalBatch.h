#pragma once

#include "store/RecordingMeasurements.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <span>
#include <string>
#include <tuple>
#include <vector>

namespace pallax {

/// Keeps the intervals of a recording until there are many, to be written in the order of their
/// series.
class IntervalBatch {
public:
    /// So many are written at once: a day at display ticks, and about 100 MB.
    static constexpr std::size_t kMostKept = std::size_t{1} << 20U;

    /// Of a field and entry in one serving cell.
    struct Series {
        FieldIndex field = 0;
        EntryId entry = kNoEntry;
        std::optional<std::size_t> cell = {}; ///< among those that were found
        std::string format = {};              ///< of its first number, as printf() has it
        bool isReal = false;
    };
    struct Row {
        std::uint32_t series;
        Interval::Part part;
        std::int64_t time; ///< milliseconds since the first packet
        std::int64_t hold; ///< milliseconds
        std::int64_t whole;
        std::uint64_t packet;
        FieldValue value;
    };

    /// `measurements`, which names what the intervals are of, must outlive the batch. Times count
    /// from `first`.
    IntervalBatch(const RecordingMeasurements& measurements, Time first)
        : _measurements(measurements), _first(first) {}

    void add(const Interval& interval);
    bool isFull() const { return _rows.size() >= kMostKept; }
    /// The intervals that were added so far, also those that have been written.
    std::uint64_t count() const { return _count; }
    const RecordingMeasurements& measurements() const { return _measurements; }
    /// Since 1970.
    std::chrono::milliseconds first() const;

    /// Those that are kept, by series and time.
    std::span<const Row> sorted();
    const Series& series(const Row& row) const { return _series[row.series]; }
    void clear();

private:
    const RecordingMeasurements& _measurements;
    Time _first;
    std::uint64_t _count = 0;
    std::vector<Row> _rows;
    std::vector<Series> _series;
    std::map<std::tuple<FieldIndex, EntryId, std::optional<std::size_t>>, std::uint32_t> _places;
};

} // namespace pallax
