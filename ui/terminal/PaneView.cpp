#include "ui/terminal/PaneView.h"

#include "text/AgeText.h"
#include "ui/drawing/MarkedText.h"
#include "ui/drawing/TextWidth.h"
#include "ui/terminal/TerminalToolkit.h"

#include <algorithm>
#include <array>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr int kLeastColumnsForCurves = 100; // on a narrower screen rows have only name and value
constexpr Style kBold{.bold = true};
constexpr Style kDim{.dim = true};

/// The titles from `first` on, joined, after a mark if some are omitted.
std::string breadcrumbs(const TerminalNavigation& navigation, const Marks& marks,
                        std::size_t first) {
    const auto& screens = navigation.screens();
    std::string path(first == 0 ? "" : marks.more);
    for (std::size_t index = first; index < screens.size(); ++index) {
        path += path.empty() ? "" : marks.crumb;
        path += screens[index]->title();
    }
    return path;
}

/// How many titles must be omitted, starting with the first; never the last one.
std::size_t leftOutCrumbs(const TerminalNavigation& navigation, const Marks& marks, int columns) {
    const std::size_t last = navigation.screens().size() - 1;
    std::size_t first = 0;
    while (first < last && columnsOf(breadcrumbs(navigation, marks, first)) > columns) {
        ++first;
    }
    return first;
}

/// "2 of 18" rows with a filter, "4 cells" in a table without one.
std::string countText(TerminalTable& table) {
    const std::string shown = std::to_string(table.shownRows());
    const ColumnTable* const list = table.list();
    if (!table.filter().empty()) {
        return shown + " of " + std::to_string(table.pane().totalRows());
    }
    if (list == nullptr) {
        return "";
    }
    const TableContent& content = list->model().content();
    std::string text = shown + " ";
    return text.append(content.rows.size() == 1 ? content.one : content.many);
}

/// The most useful keys.
std::vector<Hint> hintsFor(const ui::BarItems& items, TerminalTable& table) {
    std::vector<Hint> hints;
    if (table.list() != nullptr) {
        hints = {{"< > sort", typed(U'>')}, {"r reverse", typed(U'r')}, {"t rows", typed(U't')}};
    } else if (table.isListWithColumns()) {
        hints = {{"t table", typed(U't')}};
    }
    if (!table.filter().empty()) {
        hints.push_back(kClearFilter);
    } else if (table.pane().totalRows() > 0) {
        hints.push_back({"/ filter", typed(U'/')});
    }
    if (saveButtonOf(items) != nullptr) {
        hints.push_back({"s Save", typed(U's')});
    }
    hints.push_back({"? help", typed(U'?')});
    return hints;
}

} // namespace

void PaneView::draw(TerminalNavigation& navigation, const PaneStatus& status) {
    TerminalTable& table = terminalTable(navigation.top().table());
    const int rows = std::max(_grid.rows() - kRowsAbove - kRowsBelow, 0);
    table.setViewport(static_cast<std::size_t>(rows), rowContentBounds(_grid.columns()));
    Bars bars(_grid, _marks, _hits, status);
    drawTitle(navigation, table, bars);
    if (ColumnTable* const list = table.list()) {
        list->setArea(_grid.columns(), rows);
        list->draw(_grid, _marks, _hits, kRowsAbove,
                   [&source = table.source()](std::size_t row) { source.didSelectRow(row); });
    } else {
        drawRows(table, status);
    }
    drawUpperRule(table, bars, status);
    const int ruleRight =
        bars.drawRule(_grid.rows() - kRowsBelow, _marks.down, table.rowsBelow(), Key::PageDown);
    if (status.prompt || navigation.isToolbarShown()) {
        const ui::BarItems& items = navigation.top().toolbarItems();
        bars.drawLastRow(items, ruleRight, hintsFor(items, table));
    }
}

void PaneView::drawTitle(TerminalNavigation& navigation, TerminalTable& table, Bars& bars) {
    int right = _grid.columns() - kMargin;
    if (const std::string count = countText(table); !count.empty()) {
        right -= columnsOf(count);
        _grid.put(right, kTitleRow, count, kDim);
        right -= 1;
    }
    // The full path has priority.
    const int path = columnsOf(breadcrumbs(navigation, _marks, 0));
    drawBreadcrumbs(navigation, bars.drawOrigin(right, right - kMargin - path - kGap));
}

/// A click on a title goes back to its pane; a click on the mark, to the last omitted pane.
void PaneView::drawBreadcrumbs(TerminalNavigation& navigation, int right) {
    const Span room{kMargin, right};
    const auto& screens = navigation.screens();
    const std::size_t first = leftOutCrumbs(navigation, _marks, right - kMargin);
    int x = kMargin;
    const auto drawPart = [&](std::string_view text, std::size_t pane) {
        const int end = _grid.put(x, kTitleRow, text, kBold, room);
        _hits.add(x, kTitleRow, std::min(end, right) - x, 1,
                  [&navigation, pane] { navigation.popTo(pane, true); });
        x = end;
    };
    if (first > 0) {
        drawPart(_marks.more, first - 1);
    }
    for (std::size_t index = first; index < screens.size(); ++index) {
        if (x > kMargin) {
            x = _grid.put(x, kTitleRow, _marks.crumb, kBold, room);
        }
        drawPart(screens[index]->title(), index);
    }
    if (columnsOf(breadcrumbs(navigation, _marks, first)) > right - kMargin) {
        _grid.put(right - 1, kTitleRow, _marks.more, kBold);
    }
}

/// Also says that the values are old, if they are, or which are gone since the last tick.
void PaneView::drawUpperRule(TerminalTable& table, Bars& bars, const PaneStatus& status) {
    constexpr int kRow = kRowsAbove - 1;
    const int right = bars.drawRule(kRow, _marks.up, table.rowsAbove(), Key::PageUp);
    if (status.oldValues.empty()) {
        return drawGone(table, kRow, right);
    }
    const std::string text = oldValuesText(status.oldValues, right - kMargin);
    const int end = _grid.put(kMargin, kRow, text + " ", kBold, {kMargin, right});
    _hits.add(kMargin, kRow, end - kMargin, 1, [press = status.press] { press(typed(U'R')); });
}

void PaneView::drawGone(const TerminalTable& table, int y, int right) {
    std::string text;
    for (const std::string& name : table.pane().gone()) {
        text += text.empty() ? "gone: " : ", ";
        text += name;
    }
    if (text.empty()) {
        return;
    }
    const Span room{kMargin, right - 1};
    if (_grid.put(kMargin, y, text + " ", {}, room) > room.right) {
        _grid.put(room.right - 1, y, _marks.more, kDim);
    }
}

void PaneView::drawRows(TerminalTable& table, const PaneStatus& status) {
    const int end = _grid.rows() - kRowsBelow;
    if (const std::string why = table.pane().emptyWords(); !why.empty() && end > kRowsAbove) {
        _grid.put(kMargin, kRowsAbove, why, kDim, {kMargin, _grid.columns() - kMargin});
    }
    std::size_t shown = table.firstShown();
    for (int y = kRowsAbove; y < end && shown < table.pane().shownRows(); ++y, ++shown) {
        drawRow(table, shown, y, status);
    }
}

void PaneView::drawRow(TerminalTable& table, std::size_t shown, int y, const PaneStatus& status) {
    const PaneModel& pane = table.pane();
    const std::size_t index = pane.rowAt(shown);
    const std::shared_ptr<ui::TableCell> cell = table.source().cellForRow(index);
    const PaneRow row = pane.row(index);
    const bool isSelected = shown == pane.cursor();
    const bool isLeaf = !row.isBranch;
    const std::string_view standing =
        isLeaf ? status.standing(childPath(pane.path(), row.name)) : std::string_view();
    drawCell(table, *cell, row, y, isSelected, standing);
    if (row.number && _grid.columns() >= kLeastColumnsForCurves) {
        drawCurve(cell->contents(), status, childPath(pane.path(), row.name), y);
    }
    if (isSelected) {
        _grid.put(0, y, _marks.cursor, {.accent = true});
    }
    _hits.add(0, y, _grid.columns(), 1, [&table, shown, index] {
        table.moveCursorTo(shown);
        table.source().didSelectRow(index);
    });
}

void PaneView::drawCell(const TerminalTable& table, ui::TableCell& cell, const PaneRow& row, int y,
                        bool isSelected, std::string_view standing) {
    const ui::CellContents contents = cell.contents();
    const std::string count = row.elements ? std::to_string(*row.elements) : "";
    // A count is at the end of the text area, after a blank.
    const int width =
        columnOf(cell.contentBounds().size.width) - (count.empty() ? 0 : columnsOf(count) + 1);
    int offset = 0;
    if (contents.container != nullptr) {
        const int beyond = columnOf(contents.container->contentSize.width) -
                           columnOf(contents.container->frame.size.width);
        offset = isSelected ? std::min(table.sidewaysOffset(), std::max(beyond, 0)) : 0;
    }
    int end = 0;
    int nameEnd = 0;
    int valueStart = 0;
    for (const ui::Label* label : contents.labels) {
        const bool isName = label == contents.labels.front();
        const bool isPale = row.overdue && (row.isBranch || !isName);
        const bool isBold =
            label->font.face == ui::FontFace::BoldSystem || (row.hasChanged && !isName);
        const Style style{.bold = isBold && !isPale, .dim = isPale, .accent = isSelected};
        const int x = columnOf(label->frame.origin.x) - offset;
        nameEnd = isName ? x + columnsOf(label->text) : nameEnd;
        valueStart = x;
        (void)putMarked(_grid, {x, y}, label->text, style, {kMargin, width}, table.pane().filter());
        end = std::max(end, x + columnsOf(label->text));
    }
    if (end > width && width > 0) {
        _grid.put(width - 1, y, _marks.more, kDim);
    }
    const int last = _grid.columns() - 1;
    if (cell.accessory() == ui::CellAccessory::DisclosureIndicator) {
        _grid.put(last, y, _marks.disclosure, {.accent = isSelected});
        _grid.put(last - 1 - columnsOf(count), y, count, kDim);
    } else if (row.hasChanged) {
        _grid.put(last, y, _marks.changed, kBold);
    }
    if (!row.overdue && !standing.empty()) {
        (void)drawNote(standing, y, {nameEnd, valueStart});
    }
    if (row.overdue) {
        drawAge(*row.overdue, y, {nameEnd, row.isBranch ? last - 1 - columnsOf(count) : valueStart},
                row.isBranch ? last - 1 : last);
    }
}

/// Between the name and the value or count. Without room, a mark stands in a column beside.
void PaneView::drawAge(std::chrono::nanoseconds age, int y, Span room, int markColumn) {
    if (!drawNote(ageText(age), y, room)) {
        _grid.put(markColumn, y, _marks.old, kDim);
    }
}

/// At the end of the room; false if it does not fit.
bool PaneView::drawNote(std::string_view text, int y, Span room) {
    const int left = room.right - kGap - columnsOf(text);
    const bool fits = left >= room.left + kGap;
    if (fits) {
        _grid.put(left, y, text, kDim);
    }
    return fits;
}

/// In the same columns of each row, where name and value leave room.
void PaneView::drawCurve(const ui::CellContents& contents, const PaneStatus& status,
                         const std::string& path, int y) {
    constexpr int kCurveColumns = 24;
    constexpr int kValueColumns = 20; // of the usual values, with the margin
    const int right = _grid.columns() - kValueColumns;
    const ui::Label& name = *contents.labels.front();
    const ui::Label& value = *contents.labels.back();
    const int end = columnOf(name.frame.origin.x) + columnsOf(name.text);
    if (end + kGap <= right - kCurveColumns && columnOf(value.frame.origin.x) >= right + kGap) {
        _grid.put(right - kCurveColumns, y, status.curve(path, kCurveColumns), kDim);
    }
}

} // namespace pallax::terminal
