#pragma once

#include "query/QueryTable.h"
#include "text/Date.h"

#include <cstdint>
#include <string>

namespace pallax {

class Database;
class FieldTable;
class Timeline;
struct FieldInfo;
struct FieldValue;

/// Adds the tables of a timeline, which must outlive the database, and label(field, raw), the label
/// of a raw number:
///
/// - `packet`, `event`, `field`: the packets, what happened, and what the fields are;
/// - `tables`, `columns`: all of these tables;
/// - `cell`: the cells that were served or seen, in each role;
/// - `sample`: every value that was read; `span`: every time that a value held;
/// - series(field, buckets): a field over the whole timeline;
/// - `state`: a row for each display tick, with a column for each field that is in no list, and a
///   hidden one with its age;
/// - a table for each section and each list in it, in a schema with the name of the technology, a
///   row for each reading: lte.serving_cell_measurements. A field is a column, so that its name in
///   the registry is an expression of SQL (lte.serving_cell_measurements.measured_rsrp).
void addTimelineTables(Database& database, Timeline& timeline);

// For the tables.

/// A time as a column has it: UTC in microseconds.
std::int64_t microseconds(Time time);

/// Packets from `first` to `last`; none if `first` is greater.
struct PacketRange {
    std::uint64_t first = 1;
    std::uint64_t last = 0;
    const std::function<bool()>* mayContinue = nullptr; ///< RowBounds

    /// Called with each packet that is read: asks now and then, and throws to stop the query.
    void noteRead(std::uint64_t packet) const;
};
/// The packets that the bounds leave.
PacketRange packetsIn(const Timeline& timeline, const RowBounds& bounds);

/// The last part of a field's name.
std::string lastWordOf(const std::string& name);

/// Gives a value in the type of its field: a number; else a text. A field of numbers is NULL while
/// its value is a text.
void giveTyped(const FieldInfo& field, const FieldValue& value, ColumnValue& column);
/// Gives its number, or NULL if it has none.
void giveNumber(const FieldValue& value, ColumnValue& column);

} // namespace pallax
