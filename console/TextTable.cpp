#include "console/TextTable.h"

#include "text/Printable.h"

#include <algorithm>
#include <charconv>
#include <system_error>

namespace pallax {

namespace {

/// A table is for people: each letter counts as one column.
std::size_t columnsOf(std::string_view text) {
    return static_cast<std::size_t>(std::count_if(text.begin(), text.end(), [](char character) {
        constexpr unsigned kContinuation = 0xC0;
        return (static_cast<unsigned char>(character) & kContinuation) != 0x80U;
    }));
}

bool isNumber(std::string_view text) {
    double number = 0.0;
    const char* const end = text.data() + text.size();
    const auto read = std::from_chars(text.data(), end, number);
    return read.ec == std::errc() && read.ptr == end;
}

} // namespace

TextTable::Row TextTable::inOneLine(Row cells) {
    for (std::string& cell : cells) {
        cell = printable(cell);
    }
    return cells;
}

bool TextTable::isOfNumbers(std::size_t column) const {
    return std::all_of(_rows.begin(), _rows.end(), [column](const Row& row) {
        return column >= row.size() || row[column].empty() || isNumber(row[column]);
    });
}

std::size_t TextTable::widthOf(std::size_t column) const {
    std::size_t width = columnsOf(_head[column]);
    for (const Row& row : _rows) {
        width = std::max(width, column < row.size() ? columnsOf(row[column]) : 0);
    }
    return width;
}

void TextTable::appendTo(std::string& out) const {
    struct Column {
        std::size_t width;
        bool isRight;
    };
    std::vector<Column> columns;
    for (std::size_t column = 0; column < _head.size(); ++column) {
        columns.push_back({widthOf(column), isOfNumbers(column)});
    }
    const auto append = [&](const Row& row) {
        const std::size_t begin = out.size();
        for (std::size_t column = 0; column < row.size(); ++column) {
            constexpr std::string_view kGap = "  ";
            const std::size_t missing = columns[column].width - columnsOf(row[column]);
            out.append(column == 0 ? "" : kGap);
            out.append(columns[column].isRight ? missing : 0, ' ');
            out.append(row[column]);
            out.append(columns[column].isRight ? 0 : missing, ' ');
        }
        out.erase(std::max(begin, out.find_last_not_of(' ') + 1));
        out += '\n';
    };
    append(_head);
    std::for_each(_rows.begin(), _rows.end(), append);
}

} // namespace pallax
