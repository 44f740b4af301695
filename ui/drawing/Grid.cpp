#include "ui/drawing/Grid.h"

#include "ui/drawing/TextWidth.h"

#include <algorithm>
#include <utility>

namespace pallax::terminal {

Grid::Grid(int columns, int rows)
    : _columns(std::max(columns, 0)), _rows(std::max(rows, 0)),
      _cells(static_cast<std::size_t>(_columns) * static_cast<std::size_t>(_rows)) {}

int Grid::put(int x, int y, std::string_view text, Style style, Span clip) {
    const int left = std::max(clip.left, 0);
    const int right = std::min(clip.right, _columns);
    const bool isRowInside = y >= 0 && y < _rows;
    for (Cluster& cluster : clustersOf(text)) {
        const int end = x + cluster.columns;
        if (isRowInside && x >= left && end <= right) {
            set(x, y, std::move(cluster.text), style);
            if (cluster.columns == 2) {
                set(x + 1, y, "", style);
            }
        } else if (isRowInside) {
            for (int column = std::max(x, left); column < std::min(end, right); ++column) {
                set(column, y, " ", style);
            }
        }
        x = end;
    }
    return x;
}

void Grid::clear(int x, int y, int columns, int rows) {
    for (int row = std::max(y, 0); row < std::min(y + rows, _rows); ++row) {
        for (int column = std::max(x, 0); column < std::min(x + columns, _columns); ++column) {
            set(column, row, " ", {});
        }
    }
}

void Grid::paste(const Grid& other, int x, int y) {
    for (int row = 0; row < other.rows() && y + row < _rows; ++row) {
        for (int column = 0; column < other.columns() && x + column < _columns; ++column) {
            _cells[index(x + column, y + row)] = other.at(column, row);
        }
    }
}

void Grid::fill(Span span, int y, std::string_view text, Style style) {
    for (int column = span.left; column < span.right; ++column) {
        put(column, y, text, style);
    }
}

void Grid::set(int x, int y, std::string text, Style style) {
    separateWideCharacterAt(x, y);
    _cells[index(x, y)] = {std::move(text), style};
}

/// Overwriting one half of a wide character blanks its other half.
void Grid::separateWideCharacterAt(int x, int y) {
    if (_cells[index(x, y)].text.empty() && x > 0) {
        _cells[index(x - 1, y)].text.assign(1, ' ');
    }
    if (x + 1 < _columns && _cells[index(x + 1, y)].text.empty()) {
        _cells[index(x + 1, y)].text.assign(1, ' ');
    }
}

std::vector<std::string> Grid::lines() const {
    std::vector<std::string> lines;
    for (int y = 0; y < _rows; ++y) {
        std::string line;
        for (int x = 0; x < _columns; ++x) {
            line += at(x, y).text;
        }
        line.erase(line.find_last_not_of(' ') + 1);
        lines.push_back(std::move(line));
    }
    return lines;
}

std::string Grid::text() const {
    std::string text;
    for (const std::string& line : lines()) {
        text += line;
        text += '\n';
    }
    return text;
}

} // namespace pallax::terminal
