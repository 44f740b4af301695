#include "ui/terminal/TerminalTable.h"

#include "ui/terminal/TerminalMetrics.h"

#include <algorithm>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr char lowered(char letter) {
    return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

bool passes(const ui::RowText& row, std::string_view filter) {
    return findIgnoringCase(row.name, filter) != std::string_view::npos ||
           (row.value && findIgnoringCase(*row.value, filter) != std::string_view::npos);
}

} // namespace

std::size_t findIgnoringCase(std::string_view text, std::string_view wanted) {
    const auto found =
        std::search(text.begin(), text.end(), wanted.begin(), wanted.end(),
                    [](char left, char right) { return lowered(left) == lowered(right); });
    return found == text.end() && !wanted.empty() ? std::string_view::npos
                                                  : static_cast<std::size_t>(found - text.begin());
}

TerminalTable& terminalTable(ui::TableView& table) {
    return static_cast<TerminalTable&>(table);
}

TerminalTable::TerminalTable(ui::TableSource& source, ui::Rect contentBounds,
                             NeedsDisplay needsDisplay)
    : _source(source), _contentBounds(contentBounds), _needsDisplay(std::move(needsDisplay)) {}

std::shared_ptr<ui::TableCell> TerminalTable::dequeueReusableCell(std::string_view /*identifier*/) {
    return nullptr;
}

void TerminalTable::reloadData() {
    filterRows();
    findCursor();
    keepCursorInWindow();
    _needsDisplay();
}

void TerminalTable::deselectRow(std::size_t /*row*/, bool /*animated*/) {
    _needsDisplay();
}

void TerminalTable::sizeToFit() {
    setViewport(totalRows(), _contentBounds);
}

void TerminalTable::setViewport(std::size_t rows, ui::Rect contentBounds) {
    _windowRows = std::max<std::size_t>(rows, 1);
    if (contentBounds != _contentBounds) {
        _contentBounds = contentBounds;
        _sidewaysOffset = 0;
    }
    if (!_cursorName) {
        rememberCursor(); // of a table that was never reloaded
    }
    keepCursorInWindow();
}

std::size_t TerminalTable::shownRows() const {
    return _filter.empty() ? totalRows() : _matches.size();
}

std::size_t TerminalTable::rowAt(std::size_t shown) const {
    return _filter.empty() ? shown : _matches[shown];
}

std::optional<std::size_t> TerminalTable::cursorRow() const {
    if (_cursor >= shownRows()) {
        return std::nullopt;
    }
    return rowAt(_cursor);
}

void TerminalTable::moveCursor(std::ptrdiff_t rows) {
    const auto target = static_cast<std::ptrdiff_t>(_cursor) + rows;
    moveCursorTo(static_cast<std::size_t>(std::max<std::ptrdiff_t>(target, 0)));
}

void TerminalTable::moveCursorTo(std::size_t shown) {
    const std::size_t count = shownRows();
    _cursor = count == 0 ? 0 : std::min(shown, count - 1);
    _sidewaysOffset = 0;
    rememberCursor();
    keepCursorInWindow();
    _needsDisplay();
}

void TerminalTable::scroll(std::ptrdiff_t rows) {
    const auto last = static_cast<std::ptrdiff_t>(lastFirstShown());
    const auto target = static_cast<std::ptrdiff_t>(_firstShown) + rows;
    _firstShown = static_cast<std::size_t>(std::clamp<std::ptrdiff_t>(target, 0, last));
    moveCursorTo(std::clamp(_cursor, _firstShown, _firstShown + _windowRows - 1));
}

std::ptrdiff_t TerminalTable::page() const {
    return static_cast<std::ptrdiff_t>(std::max<std::size_t>(_windowRows, 2) - 1);
}

void TerminalTable::setFilter(std::string text) {
    _filter = std::move(text);
    filterRows();
    findCursor();
    keepCursorInWindow();
    _needsDisplay();
}

bool TerminalTable::scrollSideways(int columns) {
    const auto row = cursorRow();
    if (!row) {
        return false;
    }
    const std::shared_ptr<ui::TableCell> cell = _source.cellForRow(*row);
    const ui::ScrollContainer* container = cell->contents().container;
    if (container == nullptr) {
        return false;
    }
    const int beyond =
        columnOf(std::max(container->contentSize.width - container->frame.size.width, 0.0));
    const int current = std::min(_sidewaysOffset, beyond); // new data may be shorter
    _sidewaysOffset = std::clamp(current + columns, 0, beyond);
    if (_sidewaysOffset == current) {
        return false;
    }
    _needsDisplay();
    return true;
}

void TerminalTable::filterRows() {
    _matches.clear();
    if (_filter.empty()) {
        return;
    }
    for (std::size_t row = 0; row < totalRows(); ++row) {
        if (passes(_source.textOfRow(row), _filter)) {
            _matches.push_back(row);
        }
    }
}

/// Where there is no row for now, the last one's name is kept: it may come back.
void TerminalTable::rememberCursor() {
    if (const auto row = cursorRow()) {
        _cursorName = _source.textOfRow(*row).name;
    }
}

/// Mostly the row is where it was. Otherwise the nearest one of that name is taken, and where
/// there is none any more, the cursor stays at its place.
void TerminalTable::findCursor() {
    const std::size_t count = shownRows();
    const auto isIt = [this, count](std::size_t shown) {
        return shown < count && _source.textOfRow(rowAt(shown)).name == _cursorName;
    };
    const std::size_t reach = _cursorName ? std::max(count, _cursor + 1) : 0;
    for (std::size_t distance = 0; distance < reach; ++distance) {
        if (isIt(_cursor + distance)) {
            _cursor += distance;
            return;
        }
        if (distance <= _cursor && isIt(_cursor - distance)) {
            _cursor -= distance;
            return;
        }
    }
    _cursor = count == 0 ? 0 : std::min(_cursor, count - 1);
    _sidewaysOffset = 0;
    rememberCursor();
}

std::size_t TerminalTable::lastFirstShown() const {
    const std::size_t count = shownRows();
    return count > _windowRows ? count - _windowRows : 0;
}

void TerminalTable::keepCursorInWindow() {
    _firstShown = std::min(_firstShown, lastFirstShown());
    if (_cursor < _firstShown) {
        _firstShown = _cursor;
    } else if (_cursor >= _firstShown + _windowRows) {
        _firstShown = _cursor - _windowRows + 1;
    }
}

} // namespace pallax::terminal
