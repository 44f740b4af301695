#include "fields/Measures.h"
#include "overview/ValueFacts.h"
#include "ui/contents/GraphContent.h"
#include "ui/terminal/FrontEnd.h"

#include <chrono>
#include <cmath>

namespace pallax::terminal {

namespace {

constexpr std::chrono::minutes kSparklineSpan{5};
/// So few that a timeline's reduction usually suffices, which costs nearly nothing.
constexpr std::size_t kFewPoints = 8;

bool isLevel(const FieldInfo& field) {
    return measureOf(field.name) || field.unit == "dBm" || field.unit == "dB";
}

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
    return {moment, values, names, time, profile};
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
        return setMessage(kNoValueHere);
    }
    if (character == U'i') {
        return openValue(std::move(*leaf));
    }
    setMessage(toggleInGraph(_graph, _shown, leaf->path));
}

std::string_view FrontEnd::standingOfRow(const std::string& path) {
    _shown.update();
    const CurrentValues* values = _shown.values();
    const auto leaf = values != nullptr ? leafAt(*values, path) : std::nullopt;
    const auto value = leaf && leaf->inner.empty() ? valueOf(*values, *leaf) : std::nullopt;
    return value ? nameOf(standingOf(values->fields()[value->field], value->value)) : "";
}

/// A curve of the last minutes for a row that shows a level; empty for others.
std::string FrontEnd::curveOfRow(const std::string& path, int columns) {
    _shown.update();
    const CurrentValues* values = _shown.hasTimeline() ? _shown.values() : nullptr;
    const auto leaf = values != nullptr ? leafAt(*values, path) : std::nullopt;
    const auto value = leaf && leaf->inner.empty() ? valueOf(*values, *leaf) : std::nullopt;
    if (!value || !std::isfinite(value->value.number) || !isLevel(values->fields()[value->field])) {
        return "";
    }
    const CurveWindow& window = _shown.choose(kSparklineSpan);
    return sparkline(_marks, _shown.curve(*leaf, kFewPoints), window.from, window.to, columns);
}

Overview FrontEnd::overviewWithCurves() {
    Overview overview = _surroundings.overview();
    _shown.update();
    if (!_shown.hasTimeline()) {
        return overview;
    }
    const CurveWindow& window = _shown.choose(kSparklineSpan);
    overview.curvesFrom = window.from;
    overview.curvesTo = window.to;
    for (const StatusCell& cell : overview.status.cells) {
        for (const StatusValue& level : cell.levels) {
            const LeafName leaf{level.field, level.entry, ""};
            overview.curves.push_back({leaf, _shown.curve(leaf, kFewPoints)});
        }
    }
    return overview;
}

} // namespace pallax::terminal
