#pragma once

#include "overview/StatusWatch.h"
#include "ui/drawing/Grid.h"
#include "ui/drawing/Marks.h"

#include <string>
#include <vector>

namespace pallax::terminal {

struct TextPiece {
    std::string text;
    Style style = {};
};
using TextRow = std::vector<TextPiece>;

/// An overview as rows of text, in one column or, on a wide screen, in two or three side by side.
struct OverviewText {
    struct Column {
        Span span;
        std::vector<TextRow> rows;
    };
    std::vector<Column> columns;

    /// Of the longest column.
    int rows() const;
};

/// For these columns of a screen. Lists are shortened so that everything fits into `rows`
/// rows, but keep their first entries.
OverviewText overviewText(const Overview& overview, const Marks& marks, Span area, int rows);

} // namespace pallax::terminal
