#include "ui/terminal/FrontEnd.h"

#include <cmath>

namespace pallax::terminal {

namespace {

/// The text of the row of that name; nothing if there is none.
std::optional<std::string> textOfRow(const PaneModel& pane, const std::string& name) {
    for (std::size_t row = 0; row < pane.totalRows(); ++row) {
        if (pane.nodeAt(row)->displayName() == name) {
            return pane.row(row).text;
        }
    }
    return std::nullopt;
}

} // namespace

ShownValues::Source FrontEnd::Surroundings::valueSource() const {
    return {moment, values, names, time};
}

/// The leaf under the cursor of the topmost pane; nothing on a branch.
std::optional<PaneLeaf> FrontEnd::leafAtCursor() const {
    const PaneModel& pane = table()->pane();
    const auto row = pane.cursorRow();
    if (!row || pane.nodeAt(*row)->childNodes() != nullptr) {
        return std::nullopt;
    }
    const std::string name = pane.nodeAt(*row)->displayName();
    const std::weak_ptr<ui::TableScreen> screen = _toolkit.navigation()->screens().back();
    return PaneLeaf{
        childPath(pane.path(), name), name, [screen, name]() -> std::optional<std::string> {
            const auto shown = screen.lock();
            return shown ? textOfRow(terminalTable(shown->table()).pane(), name) : std::nullopt;
        }};
}

void FrontEnd::openRow() {
    auto leaf = leafAtCursor();
    openOrScroll(*table(), false);
    if (leaf) {
        openValue(std::move(*leaf));
    }
}

void FrontEnd::openValue(PaneLeaf leaf) {
    _pages.open(ValuePage(_shown, std::move(leaf),
                          {[this](const std::string& text) {
                               _surroundings.copy(text);
                               setMessage("Copied: " + text);
                           },
                           [this](const LeafName& name) { setMessage(_graph.toggle(name)); }}));
    needsDisplay();
}

void FrontEnd::openGraph() {
    _pages.open(GraphPage(_shown, _graph));
    needsDisplay();
}

void FrontEnd::handleValueKey(char32_t character) {
    if (character == U'V') {
        return openGraph();
    }
    auto leaf = leafAtCursor();
    if (!leaf) {
        return;
    }
    if (character == U'i') {
        return openValue(std::move(*leaf));
    }
    _shown.update();
    const auto name =
        _shown.values() != nullptr ? leafAt(*_shown.values(), leaf->path) : std::nullopt;
    const auto value = name ? valueOf(*_shown.values(), *name) : std::nullopt;
    const bool isNumber = value && name->inner.empty() && std::isfinite(value->value.number);
    setMessage(isNumber ? _graph.toggle(*name) : "Only numbers have a curve.");
}

} // namespace pallax::terminal
