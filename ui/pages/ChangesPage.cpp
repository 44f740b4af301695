#include "ui/pages/ChangesPage.h"

#include "ui/pages/EventText.h"

namespace pallax::terminal {

namespace {

constexpr std::string_view kNothingDiffers = "Nothing differs.";

} // namespace

PageAnswer ChangesPage::handle(const KeyEvent& event) {
    const bool closes = event.key == Key::Character && event.character == U'd';
    if (closes || goesBack(event)) {
        return PageAnswer::Closes;
    }
    return _scrolling.handle(event) ? PageAnswer::Handled : PageAnswer::NotMine;
}

void ChangesPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    const ChangesContent& content = _source();
    const PageFrame frame(screen, around, content.title());
    const int lines = static_cast<int>(content.lines().size());
    _scrolling.fit(frame.rows(), lines);
    const int end = std::min(lines, _scrolling.first() + frame.rows());
    for (int line = _scrolling.first(); line < end; ++line) {
        const std::string text =
            eventWords(content.lines()[static_cast<std::size_t>(line)], screen.marks);
        const bool isTitle = !text.starts_with(' ');
        const int y = kRowsAbove + line - _scrolling.first();
        const Span span = frame.span();
        if (screen.grid.put(kMargin, y, text, {.bold = isTitle}, span) > span.right) {
            screen.grid.put(span.right - 1, y, screen.marks.more, {.dim = true});
        }
    }
    if (lines == 0) {
        screen.grid.put(kMargin, kRowsAbove, kNothingDiffers, {}, frame.span());
    }
    frame.finish(_scrolling, lines, {{"d panes", typed(U'd')}, {"? help", typed(U'?')}});
}

} // namespace pallax::terminal
