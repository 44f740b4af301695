#pragma once

#include "query/Database.h"

#include <cstdint>
#include <functional>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// An answer that is not in the format.
class NoAnswer : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// The number in a cell; 0 if there is none.
std::int64_t integerIn(const QueryValue& cell);
/// The text in a cell; empty if there is none.
std::string textIn(const QueryValue& cell);

/// Reads an answer of ClickHouse in the format TabSeparatedWithNamesAndTypes, in pieces of any
/// size. Integers and real numbers become numbers, NULL and NaN become NULL, everything else a
/// text.
class AnswerRows {
public:
    using TakeColumns = std::function<void(const std::vector<std::string>& names)>;
    using TakeRow = std::function<void(std::vector<QueryValue> row)>;

    AnswerRows(TakeColumns takeColumns, TakeRow takeRow)
        : _takeColumns(std::move(takeColumns)), _takeRow(std::move(takeRow)) {}

    /// Throws NoAnswer.
    void add(std::string_view piece);
    /// Call it once, at the end. Throws NoAnswer if there must be more.
    void finish() const;

private:
    enum class Kind { Integer, Real, Text };

    void takeLine(std::string_view line);
    static Kind kindOf(std::string_view type);

    TakeColumns _takeColumns;
    TakeRow _takeRow;
    std::string _line; ///< the beginning of one
    std::size_t _lines = 0;
    std::vector<std::string> _names;
    std::vector<Kind> _kinds;
};

} // namespace pallax
