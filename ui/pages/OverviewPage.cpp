#include "ui/pages/OverviewPage.h"

#include <algorithm>

namespace pallax::terminal {

namespace {

constexpr std::string_view kOverviewTitle = "Overview";
constexpr std::string_view kNothing = "Nothing is known about the radio.";

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
    const PageFrame frame(screen, around, kOverviewTitle);
    const OverviewText text = overviewText(_source(), screen.marks, frame.span(), frame.rows());
    _scrolling.fit(frame.rows(), text.rows());
    const auto first = static_cast<std::size_t>(_scrolling.first());
    for (const OverviewText::Column& column : text.columns) {
        const std::size_t past =
            std::min(column.rows.size(), first + static_cast<std::size_t>(frame.rows()));
        for (std::size_t index = first; index < past; ++index) {
            drawRow(screen.grid, screen.marks, column.rows[index], column.span,
                    kRowsAbove + static_cast<int>(index - first));
        }
    }
    if (text.rows() == 0) {
        screen.grid.put(kMargin, kRowsAbove, kNothing, {}, frame.span());
    }
    frame.finish(_scrolling, text.rows(), {{"o panes", typed(U'o')}, {"? help", typed(U'?')}});
}

} // namespace pallax::terminal
