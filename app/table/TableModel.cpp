#include "app/table/TableModel.h"

#include "app/pane/FindIgnoringCase.h"
#include "app/table/TableOrder.h"

#include <algorithm>
#include <map>
#include <utility>

namespace pallax {

namespace {

std::optional<std::size_t> columnNamed(const TableContent& content, std::string_view name) {
    const auto& columns = content.columns;
    const auto found = std::find_if(columns.begin(), columns.end(),
                                    [name](const auto& column) { return column.name == name; });
    return found != columns.end() ? std::optional<std::size_t>(found - columns.begin())
                                  : std::nullopt;
}

std::string withUnit(const TableCell& cell, const TableColumn& column) {
    std::string text = cell.text;
    if (cell.number && !column.unit.empty()) {
        text.append(1, ' ').append(column.unit);
    }
    return text;
}

} // namespace

void TableModel::show(TableContent content) {
    _content = std::move(content);
    ++_version;
    _changed.clear();
    _filter.clear();
    _cursor = 0;
    _cursorKey.reset();
    _chosenName.reset();
    _isDescending = false;
    _hiddenNames.clear();
    _showsExtra = false;
    resolveColumns();
    arrange();
    rememberCursor();
}

void TableModel::update(TableContent content, Changes changes) {
    const TableContent before = std::exchange(_content, std::move(content));
    ++_version;
    _changed.clear();
    if (changes == Changes::Mark) {
        markChanges(before);
    }
    resolveColumns();
    arrange();
}

bool TableModel::hasChanged(std::size_t row, std::size_t column) const {
    return !_changed.empty() && _changed[row * _content.columns.size() + column];
}

void TableModel::markChanges(const TableContent& before) {
    std::multimap<std::string_view, const TableRow*> rows; // of one key, in their order
    for (const TableRow& row : before.rows) {
        rows.emplace(row.key, &row);
    }
    std::vector<std::optional<std::size_t>> columns;
    for (const TableColumn& column : _content.columns) {
        columns.push_back(columnNamed(before, column.name));
    }
    _changed.reserve(_content.rows.size() * columns.size());
    for (const TableRow& row : _content.rows) {
        const auto [found, end] = rows.equal_range(row.key);
        const TableRow* const same = found != end ? found->second : nullptr;
        for (std::size_t column = 0; column < columns.size(); ++column) {
            const TableCell* cell =
                same != nullptr && columns[column] ? &same->cells[*columns[column]] : nullptr;
            const std::string& text = row.cells[column].text;
            _changed.push_back(!text.empty() && !_content.columns[column].isExtra &&
                               (cell == nullptr || cell->text != text));
        }
        if (same != nullptr) {
            rows.erase(found);
        }
    }
}

void TableModel::resolveColumns() {
    _chosen = _chosenName ? columnNamed(_content, *_chosenName) : std::nullopt;
}

void TableModel::setFilter(std::string text) {
    _filter = std::move(text);
    arrange();
}

bool TableModel::passes(const TableRow& row) const {
    bool passes = _filter.empty();
    for (std::size_t column = 0; !passes && column < row.cells.size(); ++column) {
        passes = !_content.columns[column].isExtra &&
                 findIgnoringCase(row.cells[column].text, _filter) != std::string_view::npos;
    }
    return passes;
}

void TableModel::arrange() {
    _shown.clear();
    for (std::size_t row = 0; row < _content.rows.size(); ++row) {
        if (passes(_content.rows[row])) {
            _shown.push_back(row);
        }
    }
    if (_chosen) {
        sortRows(_shown, _content.rows, *_chosen, _isDescending);
    }
    findCursor();
}

std::optional<std::size_t> TableModel::cursorRow() const {
    return _cursor < _shown.size() ? std::optional(_shown[_cursor]) : std::nullopt;
}

void TableModel::moveCursorTo(std::size_t shown) {
    _cursor = _shown.empty() ? 0 : std::min(shown, _shown.size() - 1);
    rememberCursor();
}

void TableModel::select(std::size_t row) {
    const auto found = std::find(_shown.begin(), _shown.end(), row);
    if (found != _shown.end()) {
        moveCursorTo(static_cast<std::size_t>(found - _shown.begin()));
    }
}

/// While there is no row, keeps the last row's key, because that row may return.
void TableModel::rememberCursor() {
    if (const auto row = cursorRow()) {
        _cursorKey = _content.rows[*row].key;
    }
}

/// Moves the cursor to the nearest row of its key, or keeps it in place if there is none.
void TableModel::findCursor() {
    const auto distance = [this](std::size_t shown) {
        return shown < _cursor ? _cursor - shown : shown - _cursor;
    };
    std::optional<std::size_t> nearest;
    for (std::size_t shown = 0; _cursorKey && shown < _shown.size(); ++shown) {
        const bool isIt = _content.rows[_shown[shown]].key == *_cursorKey;
        if (isIt && (!nearest || distance(shown) < distance(*nearest))) {
            nearest = shown;
        }
    }
    moveCursorTo(nearest.value_or(_cursor));
}

bool TableModel::isHidden(std::size_t column) const {
    return std::find(_hiddenNames.begin(), _hiddenNames.end(), _content.columns[column].name) !=
           _hiddenNames.end();
}

std::vector<std::size_t> TableModel::choices() const {
    std::vector<std::size_t> all;
    for (std::size_t column = 0; column < _content.columns.size(); ++column) {
        if (!isHidden(column)) {
            all.push_back(column);
        }
    }
    return all;
}

std::vector<std::size_t> TableModel::columns() const {
    std::vector<std::size_t> visible = choices();
    std::erase_if(visible, [this](std::size_t column) {
        return _content.columns[column].isExtra && !_showsExtra && column != _chosen;
    });
    return visible;
}

void TableModel::setCells(std::size_t column, std::vector<TableCell> cells) {
    for (std::size_t row = 0; row < _content.rows.size(); ++row) {
        _content.rows[row].cells[column] = std::move(cells[row]);
    }
    ++_version;
    arrange();
}

std::size_t TableModel::placeOf(std::size_t column) const {
    const std::vector<std::size_t> all = choices();
    return static_cast<std::size_t>(std::find(all.begin(), all.end(), column) - all.begin());
}

void TableModel::choose(std::size_t column) {
    _chosen = column;
    _chosenName = _content.columns[column].name;
    arrange();
}

void TableModel::chooseNext() {
    const std::vector<std::size_t> all = choices();
    const std::size_t next = _chosen ? placeOf(*_chosen) + 1 : 0;
    if (next < all.size()) {
        choose(all[next]);
    }
}

void TableModel::choosePrevious() {
    if (!_chosen) {
        return;
    }
    if (const std::size_t place = placeOf(*_chosen); place > 0) {
        choose(choices()[place - 1]);
        return;
    }
    _chosen.reset();
    _chosenName.reset();
    arrange();
}

void TableModel::reverse() {
    _isDescending = !_isDescending;
    arrange();
}

void TableModel::hide(std::size_t column) {
    if (columns().size() < 2) {
        return;
    }
    const std::size_t place = placeOf(column);
    _hiddenNames.push_back(_content.columns[column].name);
    const std::vector<std::size_t> visible = choices();
    if (_chosen && isHidden(*_chosen) && !visible.empty()) { // several may have had this name
        choose(visible[std::min(place, visible.size() - 1)]);
    }
}

void TableModel::hideChosen() {
    if (_chosen) {
        hide(*_chosen);
    }
}

void TableModel::showAllColumns() {
    _hiddenNames.clear();
    _showsExtra = true;
}

std::optional<std::string> TableModel::copied() const {
    const auto row = cursorRow();
    if (!row) {
        return std::nullopt;
    }
    const std::vector<TableColumn>& columns = _content.columns;
    const bool hasIdentity = !columns.empty() && columns.front().isIdentity;
    std::string text;
    bool hasValue = false;
    for (std::size_t column = 0; column < columns.size(); ++column) {
        const TableCell& cell = _content.rows[*row].cells[column];
        if (_chosen ? column == *_chosen
                    : columns[column].isIdentity || (!hasIdentity && !columns[column].isExtra)) {
            const char* const between = hasIdentity ? " " : "\t";
            text.append(text.empty() ? "" : between).append(withUnit(cell, columns[column]));
            hasValue = hasValue || !cell.text.empty();
        }
    }
    return hasValue ? std::optional(text) : std::nullopt;
}

} // namespace pallax
