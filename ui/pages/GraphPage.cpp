#include "ui/pages/GraphPage.h"

#include "overview/ValueFacts.h"
#include "ui/drawing/TextWidth.h"
#include "ui/drawing/Tints.h"
#include "ui/pages/EventText.h"
#include "ui/pages/PageTitle.h"

#include <algorithm>

namespace pallax::terminal {

namespace {

constexpr int kLeastPlotRows = 3;

} // namespace

PageAnswer GraphPage::handle(const KeyEvent& event) {
    if (_keys.handle(event)) {
        return PageAnswer::Handled;
    }
    const bool closes = event.key == Key::Character && event.character == U'V';
    return closes || goesBack(event) ? PageAnswer::Closes : PageAnswer::NotMine;
}

/// "a  -92.25 dBm  Measured RSRP, Serving Cell Measurements": now, or at the cursor.
std::string GraphPage::legendOf(const LeafName& leaf, const FieldInfo& field,
                                const PlotCurve& curve, const CurrentValues& values) const {
    std::string value = "no value";
    if (_keys.cursor()) {
        if (const CurvePoint* point = pointAt(curve.curve, *_keys.cursor())) {
            value = shortNumber(point->last);
            value.append(field.unit.empty() ? "" : " ").append(field.unit);
        }
    } else if (const auto current = valueOf(values, leaf)) {
        value = current->value.text();
    }
    std::string words = curve.mark + "  " + value + "  " + field.key;
    words.append(field.key.empty() ? "" : ", ").append(leaf.entry);
    return words.append(leaf.entry.empty() ? "" : ", ").append(field.section);
}

std::vector<GraphPage::Group> GraphPage::groups(int columns) {
    _shown.update();
    const CurveWindow window = _shown.choose(_keys.span());
    const CurrentValues* values = _shown.values();
    std::vector<Group> groups;
    std::size_t shown = 0;
    for (const LeafName& leaf : _graph.leaves()) {
        const auto index = values != nullptr ? values->fields().named(leaf.field) : std::nullopt;
        if (!index) {
            continue; // of another technology
        }
        const FieldInfo& field = values->fields()[*index];
        PlotCurve curve{std::string(1, static_cast<char>('a' + shown)),
                        _shown.curve(leaf, static_cast<std::size_t>(columns)), tintOfCurve(shown)};
        ++shown;
        auto group = std::find_if(groups.begin(), groups.end(), [&field](const Group& each) {
            return each.plot.unit == field.unit;
        });
        if (group == groups.end()) {
            group = groups.insert(groups.end(), Group{{window.from,
                                                       window.to,
                                                       _shown.time().ahead,
                                                       field.unit,
                                                       {},
                                                       _shown.events(),
                                                       {}},
                                                      {}});
        }
        group->legend.push_back(legendOf(leaf, field, curve, *values));
        group->plot.curves.push_back(std::move(curve));
    }
    return groups;
}

void GraphPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    Grid& grid = screen.grid;
    Bars bars(grid, screen.marks, screen.hits, around.status);
    drawPageTitle(grid, screen.marks, bars,
                  std::string(around.root).append(screen.marks.crumb) + "Graph");
    (void)bars.drawRule(kRowsAbove - 1, screen.marks.up, 0, Key::PageUp);
    const int columns = grid.columns() - 2 * kMargin;
    std::vector<Group> shown = groups(columns);
    if (shown.empty()) {
        _keys.fit({}, {}, 0);
        grid.put(kMargin, kRowsAbove, "No values: v in a pane adds one.", {},
                 {kMargin, kMargin + columns});
    } else {
        drawGroups(screen, std::move(shown));
    }
    const int ruleRight =
        bars.drawRule(grid.rows() - kRowsBelow, screen.marks.down, 0, Key::PageDown);
    bars.drawLastRow(
        around.items, ruleRight,
        {{"- + zoom", typed(U'+')}, {"V panes", typed(U'V')}, {"? help", typed(U'?')}});
}

void GraphPage::drawGroups(const PageScreen& screen, std::vector<Group> groups) {
    Grid& grid = screen.grid;
    const Span room{kMargin, grid.columns() - kMargin};
    const int columns = room.right - room.left;
    const int end = grid.rows() - kRowsBelow - 1; // the row of the cursor's time
    int legends = 0;
    int labels = 0;
    for (const Group& group : groups) {
        legends += static_cast<int>(group.legend.size());
        labels = std::max(labels, labelColumns(group.plot, grid.rows()));
    }
    const Plot& first = groups.front().plot;
    const bool hasCurves = _shown.window().firstPacket <= _shown.window().lastPacket;
    _keys.fit(first.from, first.to, hasCurves ? curveColumns(first, columns, labels) : 0);
    const int rows = (end - kRowsAbove - legends) / static_cast<int>(groups.size());
    int y = kRowsAbove;
    for (Group& group : groups) {
        for (std::size_t index = 0; index < group.legend.size() && y < end; ++index, ++y) {
            const PlotCurve& curve = group.plot.curves[index];
            grid.put(kMargin, y, group.legend[index], {}, room);
            grid.put(kMargin, y, curve.mark, {.tint = curve.tint}, room);
        }
        const int height = std::min(std::max(rows, kLeastPlotRows), end - y);
        if (hasCurves && height >= kLeastPlotRows) {
            group.plot.cursor = _keys.cursor();
            drawPlot(grid, screen.marks, group.plot, {kMargin, y, columns, height}, labels);
            y += height;
        }
    }
    std::string words(hasCurves ? _keys.spanWords() : "There are no curves yet.");
    if (_keys.cursor()) {
        words = clockText(*_keys.cursor(), first.ahead);
        const std::string event = _keys.wordsAtCursor(first.events);
        words.append(event.empty() ? "" : "  ").append(event);
    }
    grid.put(kMargin, end, eventWords(std::move(words), screen.marks), {}, room);
}

} // namespace pallax::terminal
