#include "ui/pages/PageTable.h"

#include "ui/drawing/Prompt.h"
#include "ui/drawing/TextWidth.h"

#include <algorithm>

namespace pallax::terminal {

namespace {

/// Draws a text in the rows of the content, as much as fits.
void drawText(Grid& grid, std::string_view text, int rows) {
    const Span span{kMargin, grid.columns() - kMargin};
    int y = kRowsAbove;
    for (const std::string& line : wrappedText(text, span.right - span.left)) {
        if (y < kRowsAbove + rows) {
            grid.put(kMargin, y++, line, {}, span);
        }
    }
}

} // namespace

PageAnswer PageTable::handle(const KeyEvent& event) {
    if (_filterEditor) {
        return handleFilter(event);
    }
    if (_table.handle(event)) {
        return PageAnswer::Handled;
    }
    if (goesBack(event)) {
        return goBack(event);
    }
    if (event.key == Key::Character && event.character == U'/') {
        _filterEditor.emplace().setText(model().filter());
        return PageAnswer::Handled;
    }
    if (event.key == Key::Character && event.character == U'y') {
        if (const auto copied = model().copied()) {
            _copy(*copied);
        }
        return PageAnswer::Handled;
    }
    return PageAnswer::NotMine;
}

PageAnswer PageTable::goBack(const KeyEvent& event) {
    if (event.key != Key::Escape || model().filter().empty()) {
        return PageAnswer::Closes;
    }
    model().setFilter("");
    return PageAnswer::Handled;
}

PageAnswer PageTable::handleFilter(const KeyEvent& event) {
    const bool erasesNothing = event.key == Key::Backspace && _filterEditor->text().empty();
    if (event.key == Key::Escape || erasesNothing) {
        _filterEditor.reset();
        model().setFilter("");
    } else if (event.key == Key::Enter) {
        _filterEditor.reset();
    } else if (_filterEditor->handle(event)) {
        model().setFilter(_filterEditor->text());
    } else if (event.key != Key::Character) {
        (void)_table.handle(event); // moves the cursor
    }
    return PageAnswer::Handled;
}

void PageTable::draw(const PageScreen& screen, const PageSurroundings& around, const Words& words) {
    Grid& grid = screen.grid;
    Bars bars(grid, screen.marks, screen.hits, around.status);
    drawTitle(screen, bars, around.root, words.title);
    const int rows = std::max(grid.rows() - kRowsAbove - kRowsBelow, 0);
    _table.setArea(grid.columns(), rows);
    if (model().content().rows.empty()) {
        drawText(grid, words.empty, rows);
    } else {
        _table.draw(
            grid, screen.marks, screen.hits, kRowsAbove,
            [press = around.status.press](std::size_t /*row*/) { press({.key = Key::Enter}); });
    }
    (void)bars.drawRule(kRowsAbove - 1, screen.marks.up, _table.rowsAbove(), Key::PageUp);
    const int ruleRight = bars.drawRule(grid.rows() - kRowsBelow, screen.marks.down,
                                        _table.rowsBelow(), Key::PageDown);
    drawLastRow(screen, around, bars, words, ruleRight);
}

/// The number of rows is on the right, after the origin.
void PageTable::drawTitle(const PageScreen& screen, Bars& bars, std::string_view root,
                          std::string_view title) const {
    const TableContent& content = _table.model().content();
    const std::size_t shown = _table.model().shownRows();
    const std::size_t all = content.rows.size();
    int right = screen.grid.columns() - kMargin;
    if (all > 0) {
        std::string count = std::to_string(shown);
        count.append(_table.model().filter().empty() ? " " : " of " + std::to_string(all) + " ");
        count.append(all == 1 ? content.one : content.many);
        right -= columnsOf(count);
        screen.grid.put(right, kTitleRow, count, {.dim = true});
        right -= kGap;
    }
    const std::string path = std::string(root).append(screen.marks.crumb).append(title);
    const int room = bars.drawOrigin(right, right - kMargin - columnsOf(path) - kGap);
    if (screen.grid.put(kMargin, kTitleRow, path, {.bold = true}, {kMargin, room}) > room) {
        screen.grid.put(room - 1, kTitleRow, screen.marks.more, {.dim = true});
    }
}

void PageTable::drawLastRow(const PageScreen& screen, const PageSurroundings& around, Bars& bars,
                            const Words& words, int ruleRight) {
    if (_filterEditor) {
        return drawPrompt(screen.grid, bars, "/", *_filterEditor,
                          {"Esc clear filter", {.key = Key::Escape}});
    }
    if (words.prompt.line != nullptr) {
        return drawPrompt(screen.grid, bars, words.prompt.mark, *words.prompt.line,
                          words.prompt.hint);
    }
    PaneStatus status = around.status;
    if (!words.message.empty() && !status.message) {
        status.message = words.message;
    }
    Bars last(screen.grid, screen.marks, screen.hits, status);
    std::vector<Hint> hints = words.hints;
    if (!model().content().rows.empty()) {
        hints.push_back({"< > sort", typed(U'>')});
        hints.push_back({"/ filter", typed(U'/')});
    }
    hints.push_back({"? help", typed(U'?')});
    last.drawLastRow(around.items, ruleRight, hints);
}

} // namespace pallax::terminal
