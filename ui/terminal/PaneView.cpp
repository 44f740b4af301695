#include "ui/terminal/PaneView.h"

#include "app/pane/FindIgnoringCase.h"
#include "ui/terminal/LineEditor.h"
#include "ui/terminal/TerminalToolkit.h"
#include "ui/terminal/TextWidth.h"

#include <algorithm>
#include <array>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr Hint kClearFilter{"Esc clear filter", {.key = Key::Escape}};
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

/// Bytes [begin, end) of a text.
struct Range {
    std::size_t begin = 0;
    std::size_t end = 0;
};

/// A range of `text` widened to whole characters with the combining characters after them.
Range wholeCharacters(std::string_view text, Range range) {
    Range whole = range;
    for (const Cluster& cluster : clustersOf(text)) {
        if (cluster.offset <= range.begin) {
            whole.begin = cluster.offset;
        }
        if (cluster.offset < range.end) {
            whole.end = cluster.offset + cluster.bytes;
        }
    }
    return whole;
}

} // namespace

void PaneView::draw(TerminalNavigation& navigation, const PaneStatus& status) {
    TerminalTable& table = terminalTable(navigation.top().table());
    const int rows = std::max(_grid.rows() - kRowsAbove - kRowsBelow, 0);
    table.setViewport(static_cast<std::size_t>(rows), rowContentBounds(_grid.columns()));
    Bars bars(_grid, _marks, _hits, status);
    drawTitle(navigation, table, bars);
    drawRows(table, status);
    drawUpperRule(table, bars, status);
    const int ruleRight = drawLowerRule(table, static_cast<std::size_t>(rows), bars);
    if (status.filterEditor != nullptr) {
        drawFilterPrompt(*status.filterEditor, bars);
    } else if (navigation.isToolbarShown()) {
        const ui::BarItems& items = navigation.top().toolbarItems();
        drawHints(items, table, bars.drawStatus(items, ruleRight), bars);
    }
}

void PaneView::drawTitle(TerminalNavigation& navigation, TerminalTable& table, Bars& bars) {
    int right = _grid.columns() - kMargin;
    const PaneModel& pane = table.pane();
    if (!pane.filter().empty()) {
        const std::string count =
            std::to_string(pane.shownRows()) + " of " + std::to_string(pane.totalRows());
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
}

/// Also says that the values are old, if they are.
void PaneView::drawUpperRule(const TerminalTable& table, Bars& bars, const PaneStatus& status) {
    constexpr int kRow = kRowsAbove - 1;
    const int right = bars.drawRule(kRow, _marks.up, table.firstShown(), Key::PageUp);
    if (status.oldValues.empty()) {
        return;
    }
    const std::string text = oldValuesText(status.oldValues, right - kMargin);
    const int end = _grid.put(kMargin, kRow, text + " ", kBold, {kMargin, right});
    _hits.add(kMargin, kRow, end - kMargin, 1, [press = status.press] { press(typed(U'R')); });
}

/// Returns the first column of the number of hidden rows.
int PaneView::drawLowerRule(const TerminalTable& table, std::size_t windowRows, Bars& bars) {
    const std::size_t end = table.firstShown() + windowRows;
    const std::size_t shown = table.pane().shownRows();
    const std::size_t below = shown - std::min(end, shown);
    return bars.drawRule(_grid.rows() - kRowsBelow, _marks.down, below, Key::PageDown);
}

void PaneView::drawRows(TerminalTable& table, const PaneStatus& status) {
    const int end = _grid.rows() - kRowsBelow;
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
    drawCell(table, *cell, row, y, isSelected);
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
                        bool isSelected) {
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
    for (const ui::Label* label : contents.labels) {
        const Style style{.bold = label->font.face == ui::FontFace::BoldSystem ||
                                  (row.hasChanged && label != contents.labels.front()),
                          .accent = isSelected};
        const int x = columnOf(label->frame.origin.x) - offset;
        drawLabel(*label, x, y, style, {kMargin, width}, table.pane().filter());
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

void PaneView::drawLabel(const ui::Label& label, int x, int y, Style style, Span clip,
                         std::string_view filter) {
    const std::string_view text = label.text;
    const std::size_t match =
        filter.empty() ? std::string_view::npos : findIgnoringCase(text, filter);
    if (match == std::string_view::npos) {
        _grid.put(x, y, text, style, clip);
        return;
    }
    const Range found = wholeCharacters(text, {match, match + filter.size()});
    Style underlined = style;
    underlined.underline = true;
    x = _grid.put(x, y, text.substr(0, found.begin), style, clip);
    x = _grid.put(x, y, text.substr(found.begin, found.end - found.begin), underlined, clip);
    _grid.put(x, y, text.substr(found.end), style, clip);
}

/// The most useful keys.
void PaneView::drawHints(const ui::BarItems& items, const TerminalTable& table, int from,
                         Bars& bars) {
    std::vector<Hint> hints;
    if (!table.pane().filter().empty()) {
        hints.push_back(kClearFilter);
    } else if (table.pane().totalRows() > 0) {
        hints.push_back({"/ filter", typed(U'/')});
    }
    if (saveButtonOf(items) != nullptr) {
        hints.push_back({"s Save", typed(U's')});
    }
    hints.push_back({"? help", typed(U'?')});
    bars.drawHints(hints, from);
}

void PaneView::drawFilterPrompt(const LineEditor& editor, Bars& bars) {
    const int y = _grid.rows() - 1;
    const int start = kMargin + 2; // after "/ "
    const int cursor = columnsOf(std::string_view(editor.text()).substr(0, editor.cursor()));
    const int last = _grid.columns() - 1 - kMargin;
    // A long text is scrolled so that the cursor stays visible.
    const int offset = std::max(start + cursor - last, 0);
    _grid.put(kMargin, y, "/", kBold);
    const int end = _grid.put(start - offset, y, editor.text(), {}, {start, last});
    _grid.setCursor({start + cursor - offset, y});
    const int left = _grid.columns() - kMargin - columnsOf(kClearFilter.text);
    if (left > end + 1) {
        bars.drawHint(left, kClearFilter.text, kClearFilter.key);
    }
}

} // namespace pallax::terminal
