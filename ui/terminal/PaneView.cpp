#include "ui/terminal/PaneView.h"

#include "ui/terminal/LineEditor.h"
#include "ui/terminal/TerminalToolkit.h"
#include "ui/terminal/TextWidth.h"

#include <algorithm>
#include <array>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr int kTitleRow = 0;
constexpr int kFirstTableRow = 2;
constexpr int kRowsBelowTable = 2;
constexpr int kMargin = 1; // before title and status
constexpr Style kBold{.bold = true};
constexpr Style kDim{.dim = true};

const ui::Label* labelOf(const ui::BarItems& items) {
    for (const ui::BarItem& item : items) {
        if (const auto* label = std::get_if<ui::Label>(&item)) {
            return label;
        }
    }
    return nullptr;
}

/// The titles joined, the first ones left out until the rest fits.
std::string breadcrumbs(const TerminalNavigation& navigation, const Marks& marks, int columns) {
    const auto& screens = navigation.screens();
    std::string path;
    for (std::size_t first = 0; first < screens.size(); ++first) {
        path = first == 0 ? "" : std::string(marks.more);
        for (std::size_t index = first; index < screens.size(); ++index) {
            path += path.empty() ? "" : marks.crumb;
            path += screens[index]->title();
        }
        if (columnsOf(path) <= columns) {
            break;
        }
    }
    return path;
}

/// Bytes [begin, end) of a text.
struct Range {
    std::size_t begin = 0;
    std::size_t end = 0;
};

/// A range of `text` widened to whole characters, each with the combining ones that follow it.
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

const ui::SaveButton* saveButtonOf(const ui::BarItems& items) {
    for (const ui::BarItem& item : items) {
        if (const auto* button = std::get_if<ui::SaveButton>(&item)) {
            return button;
        }
    }
    return nullptr;
}

bool isLoading(const ui::BarItems& items) {
    return std::any_of(items.begin(), items.end(), [](const ui::BarItem& item) {
        const auto* indicator = std::get_if<ui::ActivityIndicator>(&item);
        return indicator != nullptr && indicator->isSpinning;
    });
}

void PaneView::draw(TerminalNavigation& navigation, const PaneStatus& status) {
    TerminalTable& table = terminalTable(navigation.top().table());
    const int rows = std::max(_grid.rows() - kFirstTableRow - kRowsBelowTable, 0);
    table.setViewport(static_cast<std::size_t>(rows), rowContentBounds(_grid.columns()));
    drawTitle(navigation, table);
    drawRows(table);
    const int rule = _grid.rows() - kRowsBelowTable;
    _grid.fill({kMargin, _grid.columns() - kMargin}, kFirstTableRow - 1, _marks.horizontal, kDim);
    _grid.fill({kMargin, _grid.columns() - kMargin}, rule, _marks.horizontal, kDim);
    if (status.filterEditor != nullptr) {
        drawFilterPrompt(*status.filterEditor);
    } else if (navigation.isToolbarShown()) {
        drawToolbar(navigation, table, status);
    }
}

void PaneView::drawTitle(const TerminalNavigation& navigation, TerminalTable& table) {
    int right = _grid.columns() - kMargin;
    if (!table.filter().empty()) {
        const std::string count =
            std::to_string(table.shownRows()) + " of " + std::to_string(table.totalRows());
        right -= columnsOf(count);
        _grid.put(right, kTitleRow, count, kDim);
        right -= 1;
    }
    const std::string path = breadcrumbs(navigation, _marks, right - kMargin);
    _grid.put(kMargin, kTitleRow, path, kBold, {kMargin, right});
}

void PaneView::drawRows(TerminalTable& table) {
    const int end = _grid.rows() - kRowsBelowTable;
    std::size_t shown = table.firstShown();
    for (int y = kFirstTableRow; y < end && shown < table.shownRows(); ++y, ++shown) {
        drawRow(table, shown, y);
    }
}

void PaneView::drawRow(TerminalTable& table, std::size_t shown, int y) {
    const std::size_t index = table.rowAt(shown);
    const std::shared_ptr<ui::TableCell> cell = table.source().cellForRow(index);
    const ui::RowText row = table.source().textOfRow(index);
    const bool isSelected = shown == table.cursor();
    drawCell(table, *cell, row, y, isSelected);
    if (isSelected) {
        _grid.put(0, y, _marks.cursor, {.accent = true});
    }
    _hits.add(0, y, _grid.columns(), 1, [&table, shown, index] {
        table.moveCursorTo(shown);
        table.source().didSelectRow(index);
    });
}

void PaneView::drawCell(const TerminalTable& table, ui::TableCell& cell, const ui::RowText& row,
                        int y, bool isSelected) {
    const ui::CellContents contents = cell.contents();
    const std::string count = row.elements ? std::to_string(*row.elements) : "";
    // A count stands at the end of the room for texts, behind a blank.
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
        drawLabel(*label, x, y, style, {kMargin, width}, table.filter());
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

void PaneView::drawToolbar(const TerminalNavigation& navigation, const TerminalTable& table,
                           const PaneStatus& status) {
    const ui::BarItems& items = navigation.top().toolbarItems();
    const int end = drawStatus(items, status);
    drawHints(items, table, end);
}

/// A text that does not fit loses its beginning: times and file names stand at the end.
int PaneView::drawCutInFront(int x, int y, std::string_view text) {
    const int right = _grid.columns() - kMargin;
    const int beyond = x + columnsOf(text) - right;
    if (beyond <= 0) {
        return _grid.put(x, y, text);
    }
    const int start = _grid.put(x, y, _marks.more, kDim);
    (void)_grid.put(x - beyond, y, text, {}, {start, right});
    return right;
}

int PaneView::drawStatus(const ui::BarItems& items, const PaneStatus& status) {
    const int y = _grid.rows() - 1;
    int x = kMargin;
    if (status.message) {
        return drawCutInFront(x, y, *status.message);
    }
    if (isLoading(items)) {
        x = _grid.put(x, y, _marks.spinner.at(status.spinnerTurn % _marks.spinner.size())) + 1;
    }
    if (const ui::Label* label = labelOf(items)) {
        x = drawCutInFront(x, y, label->text);
    }
    return status.note.empty() ? x : _grid.put(x + 2, y, status.note, kDim);
}

/// The keys that matter here, as many as fit behind the status.
void PaneView::drawHints(const ui::BarItems& items, const TerminalTable& table, int from) {
    std::vector<std::pair<std::string, std::function<void()>>> hints;
    if (!table.filter().empty()) {
        hints.emplace_back("Esc clear filter", nullptr);
    } else if (table.totalRows() > 0) {
        hints.emplace_back("/ filter", nullptr);
    }
    if (const ui::SaveButton* save = saveButtonOf(items)) {
        hints.emplace_back("s Save", save->action);
    }
    hints.emplace_back("? help", nullptr);
    constexpr int kGap = 2;
    int right = _grid.columns() - kMargin;
    for (auto hint = hints.rbegin(); hint != hints.rend(); ++hint) {
        const int left = right - columnsOf(hint->first);
        if (left < from + kGap) {
            return;
        }
        _grid.put(left, _grid.rows() - 1, hint->first, kDim);
        if (hint->second) {
            _hits.add(left, _grid.rows() - 1, right - left, 1, hint->second);
        }
        right = left - kGap;
    }
}

void PaneView::drawFilterPrompt(const LineEditor& editor) {
    constexpr std::string_view kHint = "Esc clear filter";
    const int y = _grid.rows() - 1;
    const int start = kMargin + 2; // behind "/ "
    const int cursor = columnsOf(std::string_view(editor.text()).substr(0, editor.cursor()));
    const int last = _grid.columns() - 1 - kMargin;
    // A long text is scrolled so that the cursor stays visible.
    const int offset = std::max(start + cursor - last, 0);
    _grid.put(kMargin, y, "/", kBold);
    const int end = _grid.put(start - offset, y, editor.text(), {}, {start, last});
    _grid.setCursor({start + cursor - offset, y});
    const int left = _grid.columns() - kMargin - columnsOf(kHint);
    if (left > end + 1) {
        _grid.put(left, y, kHint, kDim);
    }
}

} // namespace pallax::terminal
