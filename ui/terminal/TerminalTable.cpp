#include "ui/terminal/TerminalTable.h"

#include "ui/terminal/TerminalMetrics.h"

#include <algorithm>
#include <utility>

namespace pallax::terminal {

TerminalTable& terminalTable(ui::TableView& table) {
    return static_cast<TerminalTable&>(table);
}

TerminalTable::TerminalTable(ui::TableSource& source, ui::Rect contentBounds,
                             NeedsDisplay needsDisplay, ListLook* look)
    : _source(source), _contentBounds(contentBounds), _needsDisplay(std::move(needsDisplay)),
      _look(look) {}

std::shared_ptr<ui::TableCell> TerminalTable::dequeueReusableCell(std::string_view /*identifier*/) {
    return nullptr;
}

PaneModel& TerminalTable::pane() const {
    if (_pane == nullptr) {
        _pane = &dynamic_cast<PaneOwner&>(_source).pane();
    }
    return *_pane;
}

std::optional<std::string> TerminalTable::cursorName() const {
    const std::optional<std::size_t> row = pane().cursorRow();
    return row ? std::optional(pane().nodeAt(*row)->displayName()) : std::nullopt;
}

/// A row that is scrolled sideways stays so as long as the cursor is on it.
void TerminalTable::reloadData() {
    if (_sidewaysOffset != 0 && cursorName() != _scrolledName) {
        _sidewaysOffset = 0;
    }
    keepCursorInWindow();
    if (_look != nullptr && _look->asTables) {
        // At each tick, so that it knows what has changed.
        _listed.refresh(_list.model(), pane(), *_look);
    } else {
        _listed.forget();
    }
    _needsDisplay();
}

bool TerminalTable::isListWithColumns() const {
    return _look != nullptr && showsTable(pane());
}

ColumnTable* TerminalTable::list() {
    if (_look == nullptr || !_look->asTables || !isListWithColumns()) {
        return nullptr;
    }
    _listed.refresh(_list.model(), pane(), *_look);
    _listed.refreshAges(_list.model(), pane(), *_look);
    return &_list;
}

/// The cursor stays on its entry.
void TerminalTable::switchLook() {
    if (ColumnTable* const shown = list()) {
        const auto row = shown->model().cursorRow();
        shown->model().setFilter("");
        pane().setFilter("");
        _look->asTables = false;
        moveCursorTo(row.value_or(0));
    } else {
        _look->asTables = true;
    }
    reloadData();
}

void TerminalTable::handleListKey(char32_t character) {
    if (character == U't' && isListWithColumns()) {
        return switchLook();
    }
    ColumnTable* const shown = list();
    if (shown != nullptr && shown->handleColumnKey(character)) {
        _needsDisplay();
    }
}

std::size_t TerminalTable::rowsAbove() {
    const ColumnTable* const shown = list();
    return shown != nullptr ? shown->rowsAbove() : _firstShown;
}

std::size_t TerminalTable::rowsBelow() {
    if (const ColumnTable* const shown = list()) {
        return shown->rowsBelow();
    }
    const std::size_t count = pane().shownRows();
    return count - std::min(_firstShown + _windowRows, count);
}

std::size_t TerminalTable::shownRows() {
    const ColumnTable* const shown = list();
    return shown != nullptr ? shown->model().shownRows() : pane().shownRows();
}

std::optional<std::size_t> TerminalTable::selectedRow() {
    const ColumnTable* const shown = list();
    return shown != nullptr ? shown->model().cursorRow() : pane().cursorRow();
}

std::optional<std::string> TerminalTable::copied() {
    const ColumnTable* const shown = list();
    const auto text = shown != nullptr ? shown->model().copied() : std::nullopt;
    return text ? text : pane().copied();
}

const std::string& TerminalTable::filter() {
    const ColumnTable* const shown = list();
    return shown != nullptr ? shown->model().filter() : pane().filter();
}

void TerminalTable::deselectRow(std::size_t /*row*/, bool /*animated*/) {
    _needsDisplay();
}

void TerminalTable::sizeToFit() {
    setViewport(pane().totalRows(), _contentBounds);
}

void TerminalTable::setViewport(std::size_t rows, ui::Rect contentBounds) {
    _windowRows = std::max<std::size_t>(rows, 1);
    if (contentBounds != _contentBounds) {
        _contentBounds = contentBounds;
        _sidewaysOffset = 0;
    }
    keepCursorInWindow();
}

void TerminalTable::moveCursor(std::ptrdiff_t rows) {
    const ColumnTable* const shown = list();
    const std::size_t cursor = shown != nullptr ? shown->model().cursor() : pane().cursor();
    const auto target = static_cast<std::ptrdiff_t>(cursor) + rows;
    moveCursorTo(static_cast<std::size_t>(std::max<std::ptrdiff_t>(target, 0)));
}

void TerminalTable::moveCursorTo(std::size_t shown) {
    if (ColumnTable* const table = list()) {
        table->moveCursorTo(shown);
    } else {
        pane().moveCursorTo(shown);
        _sidewaysOffset = 0;
        keepCursorInWindow();
    }
    _needsDisplay();
}

void TerminalTable::select(std::size_t row) {
    const auto selects = [this, row] {
        const ColumnTable* const table = list();
        const std::size_t count = shownRows();
        for (std::size_t shown = 0; shown < count; ++shown) {
            if ((table != nullptr ? table->model().rowAt(shown) : pane().rowAt(shown)) == row) {
                moveCursorTo(shown);
                return true;
            }
        }
        return false;
    };
    if (!selects() && !filter().empty()) {
        setFilter("");
        (void)selects();
    }
}

void TerminalTable::scroll(std::ptrdiff_t rows) {
    const auto last = static_cast<std::ptrdiff_t>(lastFirstShown());
    const auto target = static_cast<std::ptrdiff_t>(_firstShown) + rows;
    _firstShown = static_cast<std::size_t>(std::clamp<std::ptrdiff_t>(target, 0, last));
    moveCursorTo(std::clamp(pane().cursor(), _firstShown, _firstShown + _windowRows - 1));
}

std::ptrdiff_t TerminalTable::page() {
    if (const ColumnTable* const shown = list()) {
        return shown->page();
    }
    return static_cast<std::ptrdiff_t>(std::max<std::size_t>(_windowRows, 2) - 1);
}

void TerminalTable::setFilter(std::string text) {
    if (ColumnTable* const shown = list()) {
        shown->model().setFilter(std::move(text));
    } else {
        pane().setFilter(std::move(text));
    }
    reloadData();
}

bool TerminalTable::scrollSideways(int columns) {
    if (ColumnTable* const shown = list()) {
        const bool hasScrolled = shown->scrollSideways(columns);
        if (hasScrolled) {
            _needsDisplay();
        }
        return hasScrolled;
    }
    const auto row = pane().cursorRow();
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
    _scrolledName = cursorName();
    _needsDisplay();
    return true;
}

std::size_t TerminalTable::lastFirstShown() const {
    const std::size_t count = pane().shownRows();
    return count > _windowRows ? count - _windowRows : 0;
}

void TerminalTable::keepCursorInWindow() {
    _firstShown = std::min(_firstShown, lastFirstShown());
    const std::size_t cursor = pane().cursor();
    if (cursor < _firstShown) {
        _firstShown = cursor;
    } else if (cursor >= _firstShown + _windowRows) {
        _firstShown = cursor - _windowRows + 1;
    }
}

} // namespace pallax::terminal
