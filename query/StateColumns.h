#pragma once

#include "query/QueryTable.h"
#include "text/Date.h"
#include "timeline/FieldTable.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class CurrentValues;

/// The time of a row of `state`.
struct StateMoment {
    Time time;
    std::uint64_t packet = 0;                         ///< the latest before it
    std::optional<std::uint64_t> tick = std::nullopt; ///< nothing between two ticks
};

/// The columns of `state`: time, packet and tick, the fields that are in no list, and their ages,
/// which are hidden.
class StateColumns {
public:
    /// `taken` are names of further columns of the table, which no field has then.
    explicit StateColumns(const FieldTable& fields, const std::vector<std::string>& taken = {});

    const std::vector<Column>& columns() const { return _columns; }
    /// The name of the column of a field. Nothing for a field without one.
    std::optional<std::string> nameOf(std::string_view fieldName) const;
    void give(std::size_t column, const StateMoment& moment, const CurrentValues& values,
              ColumnValue& value) const;

    /// The name of a column for a field whose last word is not enough: "serving_cell_rx_level".
    static std::string longName(std::string_view fieldName);
    static void giveAge(const StateMoment& moment, Time read, ColumnValue& value);

private:
    const FieldTable& _fields;
    std::vector<FieldIndex> _shown; ///< in the order of their columns
    std::vector<Column> _columns;
};

} // namespace pallax
