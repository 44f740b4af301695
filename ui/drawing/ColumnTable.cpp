#include "ui/drawing/ColumnTable.h"

#include "app/table/TableColumns.h"
#include "ui/drawing/MarkedText.h"
#include "ui/drawing/TextWidth.h"

#include <algorithm>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr int kLeft = 1;      // after the cursor's mark
constexpr int kColumnGap = 2; // the first of them is for a mark
constexpr int kLeastOfText = 8;
constexpr int kMostHeadingRows = 2;
constexpr int kRowsForTwoHeadingRows = 6;

int widthOfLines(const std::vector<std::string>& lines) {
    int width = 0;
    for (const std::string& line : lines) {
        width = std::max(width, columnsOf(line));
    }
    return width;
}

/// The letters that act as keys, as the keys.
Key movingKey(const KeyEvent& event) {
    if (event.key != Key::Character) {
        return event.key;
    }
    switch (event.character) {
    case U'k':
        return Key::Up;
    case U'j':
        return Key::Down;
    case U'g':
        return Key::Home;
    case U'G':
        return Key::End;
    case U'h':
        return Key::Left;
    case U'l':
        return Key::Right;
    default:
        return Key::Character;
    }
}

} // namespace

struct ColumnTable::Brush {
    Grid& grid;
    const Marks& marks;
    HitMap& hits;
    const std::function<void(std::size_t row)>& open;
};

void ColumnTable::setArea(int columns, int rows) {
    _columns = columns;
    _rows = rows;
    keepCursorInWindow();
}

std::size_t ColumnTable::rowsBelow() const {
    const std::size_t end = _firstShown + windowRows();
    return _model.shownRows() - std::min(end, _model.shownRows());
}

void ColumnTable::moveCursor(std::ptrdiff_t rows) {
    const auto target = static_cast<std::ptrdiff_t>(_model.cursor()) + rows;
    moveCursorTo(static_cast<std::size_t>(std::max<std::ptrdiff_t>(target, 0)));
}

void ColumnTable::moveCursorTo(std::size_t shown) {
    _model.moveCursorTo(shown);
    keepCursorInWindow();
}

std::ptrdiff_t ColumnTable::page() const {
    return static_cast<std::ptrdiff_t>(std::max<std::size_t>(windowRows(), 2) - 1);
}

bool ColumnTable::scrollSideways(int columns) {
    if (columns < 0) {
        const bool isScrolled = _firstColumn > 0;
        _firstColumn -= isScrolled ? 1 : 0;
        return isScrolled;
    }
    const std::vector<std::size_t> all = _model.columns();
    if (all.empty() || shows(all.back())) {
        return false;
    }
    ++_firstColumn;
    return true;
}

bool ColumnTable::handleColumnKey(char32_t character) {
    if (!pallax::handleColumnKey(_model, character)) {
        return false;
    }
    revealChosen();
    keepCursorInWindow();
    return true;
}

bool ColumnTable::handle(const KeyEvent& event) {
    constexpr std::ptrdiff_t kWheelRows = 3;
    switch (movingKey(event)) {
    case Key::Up:
        moveCursor(-1);
        return true;
    case Key::Down:
        moveCursor(1);
        return true;
    case Key::PageUp:
        moveCursor(-page());
        return true;
    case Key::PageDown:
        moveCursor(page());
        return true;
    case Key::Home:
        moveCursorTo(0);
        return true;
    case Key::End:
        moveCursorTo(_model.shownRows());
        return true;
    case Key::WheelUp:
        moveCursor(-kWheelRows);
        return true;
    case Key::WheelDown:
        moveCursor(kWheelRows);
        return true;
    case Key::Left:
        return scrollSideways(-1);
    case Key::Right:
        return scrollSideways(1);
    case Key::Character:
        return handleColumnKey(event.character);
    default:
        return false;
    }
}

/// Widths are measured once for each content, which may have thousands of rows.
void ColumnTable::measure() const {
    if (_measuredVersion == _model.version()) {
        return;
    }
    _measuredVersion = _model.version();
    const TableContent& content = _model.content();
    _measured.assign(content.columns.size(), {});
    for (std::size_t column = 0; column < content.columns.size(); ++column) {
        for (const TableRow& row : content.rows) {
            _measured[column].width =
                std::max(_measured[column].width, columnsOf(row.cells[column].text));
        }
        _measured[column].isRight = isFlushRight(content, column);
    }
}

std::vector<std::string> ColumnTable::headingOf(std::size_t column) const {
    std::string text = pallax::headingOf(_model.content().columns[column]);
    const bool isOneLine =
        _rows < kRowsForTwoHeadingRows || columnsOf(text) <= _measured[column].width;
    return isOneLine ? std::vector<std::string>{std::move(text)} : narrowed(text, columnsOf);
}

int ColumnTable::widthOf(std::size_t column) const {
    return std::max({_measured[column].width, widthOfLines(headingOf(column)), 1});
}

std::size_t ColumnTable::fixedColumns(const std::vector<std::size_t>& columns) const {
    measure();
    std::size_t count = 0;
    int right = kLeft;
    while (count < columns.size() && _model.content().columns[columns[count]].isIdentity) {
        right += widthOf(columns[count]) + kColumnGap;
        if (right > _columns * 2 / 3) {
            break;
        }
        ++count;
    }
    return count;
}

std::vector<ColumnTable::Place> ColumnTable::places() const {
    const std::vector<std::size_t> columns = _model.columns();
    const std::size_t fixed = fixedColumns(columns);
    const std::size_t most = columns.size() > fixed ? columns.size() - fixed - 1 : 0;
    const std::size_t scrolled = std::min(_firstColumn, most);
    std::vector<Place> made;
    int x = kLeft;
    for (std::size_t index = 0; index < columns.size(); ++index) {
        if (index >= fixed && index < fixed + scrolled) {
            continue;
        }
        const int width = widthOf(columns[index]);
        const bool isFirst = index <= fixed + scrolled;
        const bool isWhole = isFirst || x + width <= _columns - 1;
        // The beginning of a text is worth showing, that of a number is not.
        const bool isText = !_measured[columns[index]].isRight;
        if (!isWhole && !(isText && x + kLeastOfText <= _columns - 1)) {
            break;
        }
        made.push_back({columns[index], x, width, headingOf(columns[index]), isWhole});
        if (!isWhole) {
            break;
        }
        x += width + kColumnGap;
    }
    return made;
}

bool ColumnTable::shows(std::size_t column) const {
    const std::vector<Place> shown = places();
    return std::any_of(shown.begin(), shown.end(), [column](const Place& place) {
        return place.column == column && place.isWhole;
    });
}

void ColumnTable::revealChosen() {
    const auto chosen = _model.chosenColumn();
    if (!chosen) {
        return;
    }
    const std::vector<std::size_t> columns = _model.columns();
    const auto place = static_cast<std::size_t>(std::find(columns.begin(), columns.end(), *chosen) -
                                                columns.begin());
    if (const std::size_t fixed = fixedColumns(columns); place >= fixed) {
        _firstColumn = std::min(_firstColumn, place - fixed);
    }
    while (!shows(*chosen) && scrollSideways(1)) {
    }
}

int ColumnTable::headingRows() const {
    if (_rows < 2 || _model.content().columns.empty()) {
        return 0;
    }
    const std::vector<Place> shown = places();
    const bool isTwo = std::any_of(shown.begin(), shown.end(), [](const Place& place) {
        return place.heading.size() == kMostHeadingRows;
    });
    return isTwo ? kMostHeadingRows : 1;
}

std::size_t ColumnTable::windowRows() const {
    return static_cast<std::size_t>(std::max(_rows - headingRows(), 1));
}

void ColumnTable::keepCursorInWindow() {
    const std::size_t rows = windowRows();
    const std::size_t count = _model.shownRows();
    _firstShown = std::min(_firstShown, count > rows ? count - rows : 0);
    const std::size_t cursor = _model.cursor();
    if (cursor < _firstShown) {
        _firstShown = cursor;
    } else if (cursor >= _firstShown + rows) {
        _firstShown = cursor - rows + 1;
    }
}

void ColumnTable::draw(Grid& grid, const Marks& marks, HitMap& hits, int top,
                       const std::function<void(std::size_t row)>& open) {
    keepCursorInWindow();
    const Brush brush{grid, marks, hits, open};
    const std::vector<Place> shown = places();
    const int headings = headingRows();
    if (headings > 0) {
        drawHeadings(brush, shown, top);
    }
    const int end = top + _rows;
    std::size_t row = _firstShown;
    for (int y = top + headings; y < end && row < _model.shownRows(); ++y, ++row) {
        drawRow(brush, shown, row, y);
    }
}

/// A click on a heading sorts by its column, the next one reverses.
void ColumnTable::drawHeadings(const Brush& brush, const std::vector<Place>& places, int top) {
    const int rows = headingRows();
    for (const Place& place : places) {
        const bool isChosen = _model.chosenColumn() == place.column;
        const Style style{.bold = isChosen, .dim = !isChosen};
        const Span clip{place.x, std::min(place.x + place.width, _columns - 1)};
        const bool isRight = _measured[place.column].isRight;
        const int blank = rows - static_cast<int>(place.heading.size());
        for (int line = blank; line < rows; ++line) {
            const std::string& text = place.heading[static_cast<std::size_t>(line - blank)];
            const int x = isRight ? place.x + place.width - columnsOf(text) : place.x;
            brush.grid.put(x, top + line, text, style, clip);
        }
        if (isChosen) {
            const auto mark = _model.isDescending() ? brush.marks.down : brush.marks.up;
            const int end = isRight ? place.width : columnsOf(place.heading.back());
            brush.grid.put(std::min(place.x + end, clip.right), top + rows - 1, mark, style);
        }
        brush.hits.add(place.x, top, place.width + 1, rows, [this, column = place.column] {
            pressHeading(_model, column);
            keepCursorInWindow();
        });
    }
    const std::vector<std::size_t> all = _model.columns();
    const bool isMore = !all.empty() && !shows(all.back());
    if (isMore) {
        brush.grid.put(_columns - 1, top + rows - 1, brush.marks.more, {.dim = true});
    }
}

void ColumnTable::drawRow(const Brush& brush, const std::vector<Place>& places, std::size_t shown,
                          int y) {
    const std::size_t row = _model.rowAt(shown);
    const bool isSelected = shown == _model.cursor();
    const Style style{.dim = _model.content().rows[row].isSecondary && !isSelected,
                      .accent = isSelected};
    for (const Place& place : places) {
        drawCell(brush, place, row, y, style);
    }
    if (isSelected) {
        brush.grid.put(0, y, brush.marks.cursor, {.accent = true});
    }
    brush.hits.add(0, y, _columns, 1, [this, shown, row, open = brush.open] {
        moveCursorTo(shown);
        open(row);
    });
}

void ColumnTable::drawCell(const Brush& brush, const Place& place, std::size_t row, int y,
                           Style style) {
    const TableCell& cell = _model.content().rows[row].cells[place.column];
    const bool hasChanged = _model.hasChanged(row, place.column);
    style.bold = hasChanged;
    const int right = std::min(place.x + place.width, _columns - 1);
    const bool isRight = _measured[place.column].isRight;
    const int x = isRight ? place.x + place.width - columnsOf(cell.text) : place.x;
    const int end =
        putMarked(brush.grid, {x, y}, cell.text, style, {place.x, right}, _model.filter());
    if (end > right) {
        brush.grid.put(right - 1, y, brush.marks.more, {.dim = true});
    }
    if (hasChanged) {
        brush.grid.put(right, y, brush.marks.changed, {.bold = true});
    } else if (cell.opens) {
        brush.grid.put(right, y, brush.marks.disclosure, {.dim = true});
    }
}

} // namespace pallax::terminal
