#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace pallax {

/// A table of texts for people, with aligned columns. Cells are in one line and safe for terminals.
class TextTable {
public:
    /// A row may have fewer cells than the head, but no more.
    void setHead(std::vector<std::string> head) { _head = inOneLine(std::move(head)); }
    void add(std::vector<std::string> row) { _rows.push_back(inOneLine(std::move(row))); }

    /// Columns of numbers are aligned right, others left. Lines do not end with blanks.
    void appendTo(std::string& out) const;

private:
    using Row = std::vector<std::string>;

    static Row inOneLine(Row cells);
    bool isOfNumbers(std::size_t column) const;
    std::size_t widthOf(std::size_t column) const;

    Row _head;
    std::vector<Row> _rows;
};

} // namespace pallax
