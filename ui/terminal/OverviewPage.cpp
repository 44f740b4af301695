#include "ui/terminal/OverviewPage.h"

#include "ui/terminal/TextWidth.h"

#include <algorithm>
#include <string>

namespace pallax::terminal {

namespace {

constexpr std::string_view kOverviewTitle = "Overview";
constexpr std::string_view kNothing = "Nothing is known about the radio.";
constexpr Style kBoldTitle{.bold = true};

/// A row that does not fit ends in a mark.
void drawRow(Grid& grid, const Marks& marks, const TextRow& row, Span span, int y) {
    int x = span.left;
    for (const TextPiece& piece : row) {
        x = grid.put(x, y, piece.text, piece.style, span);
    }
    if (x > span.right) {
        grid.put(span.right - 1, y, marks.more, {.dim = true});
    }
}

} // namespace

PageAnswer OverviewPage::handle(const KeyEvent& event) {
    const bool closes = event.key == Key::Character && event.character == U'o';
    if (closes || goesBack(event)) {
        return PageAnswer::Closes;
    }
    return _scrolling.handle(event) ? PageAnswer::Handled : PageAnswer::NotMine;
}

void OverviewPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    const Overview overview = _source();
    Grid& grid = screen.grid;
    Bars bars(grid, screen.marks, screen.hits, around.status);
    const int end = grid.columns() - kMargin;
    const std::string title =
        std::string(around.root).append(screen.marks.crumb).append(kOverviewTitle);
    const int room = bars.drawOrigin(end, end - kMargin - columnsOf(title) - kGap);
    grid.put(kMargin, kTitleRow, title, kBoldTitle, {kMargin, room});

    const int rows = std::max(grid.rows() - kRowsAbove - kRowsBelow, 0);
    const OverviewText text = overviewText(overview, screen.marks, {kMargin, end}, rows);
    _scrolling.fit(rows, text.rows());
    const auto first = static_cast<std::size_t>(_scrolling.first());
    for (const OverviewText::Column& column : text.columns) {
        const std::size_t past =
            std::min(column.rows.size(), first + static_cast<std::size_t>(rows));
        for (std::size_t index = first; index < past; ++index) {
            drawRow(grid, screen.marks, column.rows[index], column.span,
                    kRowsAbove + static_cast<int>(index - first));
        }
    }
    if (text.rows() == 0) {
        grid.put(kMargin, kRowsAbove, kNothing, {}, {kMargin, end});
    }
    (void)bars.drawRule(kRowsAbove - 1, screen.marks.up, first, Key::PageUp);
    const int below = std::max(text.rows() - _scrolling.first() - rows, 0);
    const int ruleRight = bars.drawRule(grid.rows() - kRowsBelow, screen.marks.down,
                                        static_cast<std::size_t>(below), Key::PageDown);
    bars.drawHints({{"o panes", typed(U'o')}, {"? help", typed(U'?')}},
                   bars.drawStatus(around.items, ruleRight));
}

} // namespace pallax::terminal
