#include "querying/RowWriter.h"

#include "console/Output.h"
#include "decoding/DisplayJson.h"
#include "text/Csv.h"
#include "text/Printable.h"
#include "text/Utf8.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace pallax {

namespace {

bool isNumber(const QueryValue& value) {
    return std::holds_alternative<std::int64_t>(value) || std::holds_alternative<double>(value);
}

PropertyList objectOf(const QueryValue& value) {
    if (const auto* number = std::get_if<std::int64_t>(&value)) {
        return PropertyList::integer(*number);
    }
    if (const auto* real = std::get_if<double>(&value)) {
        return PropertyList::real(*real);
    }
    const auto* text = std::get_if<std::string>(&value);
    return text != nullptr ? PropertyList(*text) : PropertyList();
}

std::string textOf(const QueryValue& value) {
    if (const auto* text = std::get_if<std::string>(&value)) {
        return *text;
    }
    const auto* real = std::get_if<double>(&value);
    if (real != nullptr && std::isinf(*real)) {
        return *real > 0 ? "inf" : "-inf"; // JSON, of which the other numbers are, has none
    }
    std::string text;
    if (isNumber(value)) {
        appendJson(text, objectOf(value));
    }
    return text;
}

/// Of a table: in one line, with control characters escaped.
std::string cellOf(const QueryValue& value) {
    std::string cell;
    appendPrintable(cell, textOf(value));
    return cell;
}

std::size_t columnsOf(std::string_view text) {
    // A table is for people: each letter counts as one column.
    return static_cast<std::size_t>(std::count_if(text.begin(), text.end(), [](char character) {
        constexpr unsigned kContinuation = 0xC0;
        return (static_cast<unsigned char>(character) & kContinuation) != 0x80U;
    }));
}

} // namespace

RowWriter::RowWriter(RowFormat format, std::vector<std::string> columns, Output& output)
    : _format(format), _columns(std::move(columns)), _output(output) {
    if (_format == RowFormat::Csv) {
        writeCsv({_columns.begin(), _columns.end()});
    }
}

void RowWriter::write(std::vector<QueryValue> row) {
    if (_format == RowFormat::Csv) {
        return writeCsv(row);
    }
    if (_format == RowFormat::Json) {
        return writeJson(row);
    }
    if (_hasHead) {
        return writeTableRow(row);
    }
    _waiting.push_back(std::move(row));
    if (_waiting.size() == kRowsForWidths) {
        writeTableHead();
    }
}

void RowWriter::finish() {
    if (_format == RowFormat::Table && !_hasHead) {
        writeTableHead();
    }
    _output.flush();
}

void RowWriter::writeCsv(const std::vector<QueryValue>& row) {
    for (std::size_t column = 0; column < row.size(); ++column) {
        _output.text().append(column == 0 ? "" : ",");
        appendCsvCell(_output.text(), textOf(row[column]));
    }
    lineDone();
}

void RowWriter::writeJson(const std::vector<QueryValue>& row) {
    std::string& out = _output.text();
    out += '{';
    for (std::size_t column = 0; column < row.size(); ++column) {
        out.append(column == 0 ? "" : ",");
        appendJsonString(out, _columns[column]);
        out += ':';
        appendJson(out, objectOf(row[column]));
    }
    out += '}';
    lineDone();
}

void RowWriter::writeTableHead() {
    _hasHead = true;
    for (std::size_t column = 0; column < _columns.size(); ++column) {
        _widths.push_back(columnsOf(cellOf(_columns[column])));
        for (const auto& row : _waiting) {
            _widths[column] = std::max(_widths[column], columnsOf(cellOf(row[column])));
        }
    }
    writeTableRow({_columns.begin(), _columns.end()});
    for (const auto& row : std::exchange(_waiting, {})) {
        writeTableRow(row);
    }
}

void RowWriter::writeTableRow(const std::vector<QueryValue>& row) {
    std::string& out = _output.text();
    const std::size_t begin = out.size();
    for (std::size_t column = 0; column < row.size(); ++column) {
        constexpr std::string_view kGap = "  ";
        const std::string cell = cellOf(row[column]);
        const std::size_t width = columnsOf(cell);
        const std::size_t missing = _widths[column] > width ? _widths[column] - width : 0;
        out.append(column == 0 ? "" : kGap);
        out.append(isNumber(row[column]) ? missing : 0, ' ');
        out.append(cell);
        out.append(isNumber(row[column]) ? 0 : missing, ' ');
    }
    out.erase(std::max(begin, out.find_last_not_of(' ') + 1));
    lineDone();
}

void RowWriter::lineDone() {
    _output.text() += '\n';
    _output.lineDone();
}

} // namespace pallax
