#include "fleet/AnswerRows.h"

#include <charconv>
#include <cmath>
#include <utility>

namespace pallax {

namespace {

constexpr std::size_t kLongestLine = std::size_t{64} << 20U;

/// A cell without its escapes.
std::string plain(std::string_view cell) {
    std::string text;
    text.reserve(cell.size());
    for (std::size_t at = 0; at < cell.size(); ++at) {
        if (cell[at] != '\\' || at + 1 == cell.size()) {
            text += cell[at];
            continue;
        }
        constexpr std::string_view kLetters = "bfnrt0";
        constexpr std::string_view kMeant("\b\f\n\r\t\0", kLetters.size());
        const std::size_t letter = kLetters.find(cell[++at]);
        text += letter != std::string_view::npos ? kMeant[letter] : cell[at];
    }
    return text;
}

template <class Number>
bool parse(std::string_view cell, Number& number) {
    const auto read = std::from_chars(cell.data(), cell.data() + cell.size(), number);
    return read.ec == std::errc() && read.ptr == cell.data() + cell.size();
}

/// Calls `take` with each part between tabs.
template <class Take>
void forEachCell(std::string_view line, const Take& take) {
    while (true) {
        const std::size_t tab = line.find('\t');
        take(line.substr(0, tab));
        if (tab == std::string_view::npos) {
            return;
        }
        line.remove_prefix(tab + 1);
    }
}

} // namespace

AnswerRows::Kind AnswerRows::kindOf(std::string_view type) {
    for (const std::string_view wrapper : {"LowCardinality(", "Nullable("}) {
        if (type.starts_with(wrapper) && type.ends_with(')')) {
            type = type.substr(wrapper.size(), type.size() - wrapper.size() - 1);
        }
    }
    if (type.starts_with("Int") || type.starts_with("UInt")) {
        return type.starts_with("Interval") ? Kind::Text : Kind::Integer;
    }
    return type.starts_with("Float") || type.starts_with("Decimal") ? Kind::Real : Kind::Text;
}

std::int64_t integerIn(const QueryValue& cell) {
    const auto* integer = std::get_if<std::int64_t>(&cell);
    return integer != nullptr ? *integer : 0;
}

std::string textIn(const QueryValue& cell) {
    const auto* text = std::get_if<std::string>(&cell);
    return text != nullptr ? *text : std::string();
}

void AnswerRows::add(std::string_view piece) {
    while (!piece.empty()) {
        const std::size_t end = piece.find('\n');
        if (_line.size() + std::min(end, piece.size()) > kLongestLine) {
            throw NoAnswer("a line of it is too long");
        }
        if (end == std::string_view::npos) {
            _line += piece;
            return;
        }
        if (_line.empty()) {
            takeLine(piece.substr(0, end));
        } else {
            takeLine(std::exchange(_line, {}) + std::string(piece.substr(0, end)));
        }
        piece.remove_prefix(end + 1);
    }
}

void AnswerRows::finish() const {
    if (!_line.empty() || _lines < 2) {
        throw NoAnswer("it ends too early");
    }
}

void AnswerRows::takeLine(std::string_view line) {
    constexpr std::size_t kNames = 1;
    constexpr std::size_t kTypes = 2;
    if (++_lines == kNames) {
        forEachCell(line, [&](std::string_view cell) { _names.push_back(plain(cell)); });
        return;
    }
    if (_lines == kTypes) {
        forEachCell(line, [&](std::string_view cell) { _kinds.push_back(kindOf(cell)); });
        if (_kinds.size() != _names.size()) {
            throw NoAnswer("its columns have no types");
        }
        _takeColumns(_names);
        return;
    }
    std::vector<QueryValue> row;
    row.reserve(_kinds.size());
    forEachCell(line, [&](std::string_view cell) {
        const Kind kind = row.size() < _kinds.size() ? _kinds[row.size()] : Kind::Text;
        std::int64_t integer = 0;
        double real = 0;
        if (cell == "\\N") {
            row.emplace_back();
        } else if (kind == Kind::Integer && parse(cell, integer)) {
            row.emplace_back(integer);
        } else if (kind == Kind::Real && parse(cell, real)) {
            row.push_back(std::isnan(real) ? QueryValue() : QueryValue(real));
        } else {
            row.emplace_back(plain(cell));
        }
    });
    if (row.size() != _kinds.size()) {
        throw NoAnswer("a row has another number of columns");
    }
    _takeRow(std::move(row));
}

} // namespace pallax
