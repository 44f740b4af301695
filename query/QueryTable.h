#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <limits>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

struct sqlite3_context;

namespace pallax {

/// A column, and what a condition on it says about the rows that are needed.
struct Column {
    enum class Role {
        Plain,        ///< nothing
        Value,        ///< nothing; it has the values of a field
        TimeStamp,    ///< UTC in microseconds: where in the recording they are
        PacketNumber, ///< likewise, by the packet's number
        FieldName,    ///< of which field they tell, by its name
        DeviceName,   ///< of which device, in a store
        // Of a table that is called like a function, series('field', 100); hidden, in their order:
        FieldArgument, ///< the name of a field, without which there are no rows
        CountArgument, ///< a whole number, which can be left out
    };

    std::string name;
    std::string_view type; ///< of SQL; empty if values of any type come
    Role role = Role::Plain;
    bool isHidden = false; ///< given only where a query names it
};

/// The rows that a query may need. Tables may give others, too, which SQLite then leaves out.
struct RowBounds {
    std::uint64_t firstPacket = 0;
    std::uint64_t lastPacket = std::numeric_limits<std::uint64_t>::max();
    std::int64_t leastTime = std::numeric_limits<std::int64_t>::min(); ///< as in the column
    std::int64_t mostTime = std::numeric_limits<std::int64_t>::max();
    std::optional<std::string> field = std::nullopt;
    std::optional<std::string> device = std::nullopt;
    std::optional<std::int64_t> count = std::nullopt;
    /// Asked during long work, if there is one; false stops the query.
    const std::function<bool()>* mayContinue = nullptr;
};

/// Takes the value of one column. What is not given is NULL.
class ColumnValue {
public:
    explicit ColumnValue(sqlite3_context& context) : _context(context) {}

    void integer(std::int64_t number);
    void real(double number);
    void text(std::string_view text);

private:
    sqlite3_context& _context;
};

/// The rows of a table for one run of a query.
class Rows {
public:
    virtual ~Rows() = default;
    /// Goes to the next row, at first to the first one; false after the last.
    virtual bool next() = 0;
    /// Gives the value of a column of the current row, by its place in the table's columns.
    virtual void give(std::size_t column, ColumnValue& value) const = 0;
    /// A number that the current row alone has, and has with any bounds: SQLite knows by it which
    /// rows it has already had when conditions are joined by OR. `place`, among these rows from 1
    /// on, is one only if the table takes no bounds.
    virtual std::int64_t number(std::int64_t place) const { return place; }
};

/// A table over what is already there.
class QueryTable {
public:
    virtual ~QueryTable() = default;
    virtual const std::vector<Column>& columns() const = 0;
    virtual std::unique_ptr<Rows> rows(const RowBounds& bounds) = 0;
    /// About how many rows there are without bounds.
    virtual double expectedRows() const = 0;
};

} // namespace pallax
