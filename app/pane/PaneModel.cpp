#include "app/pane/PaneModel.h"

#include "app/pane/FindIgnoringCase.h"
#include "text/AgeText.h"
#include "text/Format.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kTitleWithoutNode = "Pallax";

} // namespace

PaneModel::PaneModel(NodeRef node, std::string path)
    : _node(std::move(node)), _path(std::move(path)) {
    rememberCursor();
}

std::string PaneModel::title() const {
    return _node ? _node->displayName() : std::string(kTitleWithoutNode);
}

void PaneModel::setStatus(std::string text, bool isLoading) {
    _status = std::move(text);
    _isLoading = isLoading;
}

void PaneModel::show(NodeRef node, std::optional<Time> time) {
    if (node != _node) {
        _changes.replaced(std::exchange(_node, std::move(node)), time);
    }
    arrange();
}

const std::vector<NodeRef>& PaneModel::children() const {
    static const std::vector<NodeRef> kNone;
    const std::vector<NodeRef>* children = _node ? _node->childNodes() : nullptr;
    return children != nullptr ? *children : kNone;
}

std::size_t PaneModel::totalRows() const {
    return children().size();
}

NodeRef PaneModel::nodeAt(std::size_t row) const {
    return row < totalRows() ? children()[row] : nullptr;
}

PaneRow PaneModel::row(std::size_t row) const {
    PaneRow made;
    const NodeRef node = nodeAt(row);
    if (!node) {
        return made;
    }
    made.name = node->displayName();
    made.readAt = node->readAt();
    if (_ages) {
        const auto age = _ages(childPath(_path, made.name));
        made.overdue = age && age->isOverdue ? std::optional(age->age) : std::nullopt;
    }
    if (node->childNodes() != nullptr) {
        made.isBranch = true;
        made.elements = elementsOf(*node);
        return made;
    }
    made.text = textOf(*node);
    made.number = numberOf(*node);
    if (made.number) {
        made.unit = node->value()->displayNumber()->unit();
    }
    const PaneChanges::Change change = _changes.changeOf(*node, row);
    made.hasChanged = change.hasChanged;
    made.changedAt = change.at;
    return made;
}

std::string PaneModel::emptyWords() const {
    const bool isAsked = _node && _ages && totalRows() == 0;
    if (!isAsked) {
        return "";
    }
    const auto age = _ages(_path);
    return age ? formatText("Reported empty %@ ago.", {ageText(age->age)}) : "Never reported.";
}

std::vector<std::string> PaneModel::gone() const {
    return _node ? _changes.gone(*_node) : std::vector<std::string>();
}

void PaneModel::setFilter(std::string text) {
    _filter = std::move(text);
    arrange();
}

void PaneModel::setOrder(PaneOrder order) {
    _order = order;
    arrange();
}

std::size_t PaneModel::shownRows() const {
    return showsAllInDisplayOrder() ? totalRows() : _shown.size();
}

std::size_t PaneModel::rowAt(std::size_t shown) const {
    return showsAllInDisplayOrder() ? shown : _shown[shown];
}

std::optional<std::size_t> PaneModel::cursorRow() const {
    if (_cursor >= shownRows()) {
        return std::nullopt;
    }
    return rowAt(_cursor);
}

void PaneModel::moveCursorTo(std::size_t shown) {
    const std::size_t count = shownRows();
    _cursor = count == 0 ? 0 : std::min(shown, count - 1);
    rememberCursor();
}

std::optional<std::string> PaneModel::copied() const {
    const std::optional<std::size_t> row = cursorRow();
    if (!row) {
        return std::nullopt;
    }
    const NodeRef node = nodeAt(*row);
    return textOf(*node).value_or(node->displayName());
}

bool PaneModel::passes(const PallaxModelNode& node) const {
    const auto holdsFilter = [this](std::string_view text) {
        return findIgnoringCase(text, _filter) != std::string_view::npos;
    };
    return holdsFilter(node.displayName()) || holdsFilter(textOf(node).value_or(""));
}

void PaneModel::arrange() {
    _shown.clear();
    if (!showsAllInDisplayOrder()) {
        const std::vector<NodeRef>& all = children();
        for (std::size_t row = 0; row < all.size(); ++row) {
            if (passes(*all[row])) {
                _shown.push_back(row);
            }
        }
        putInOrder(_shown, all, _order);
    }
    findCursor();
}

/// While there is no row, keeps the last row's name, because that row may return.
void PaneModel::rememberCursor() {
    if (const auto row = cursorRow()) {
        _cursorName = children()[*row]->displayName();
    }
}

/// Usually the row has not moved. Otherwise the cursor moves to the nearest row of that name, or
/// stays in place if there is none.
void PaneModel::findCursor() {
    const std::size_t count = shownRows();
    const auto isIt = [this, count](std::size_t shown) {
        return shown < count && children()[rowAt(shown)]->displayName() == _cursorName;
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
    moveCursorTo(_cursor);
}

} // namespace pallax
