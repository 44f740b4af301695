#include "ui/pages/GraphPage.h"

#include "ui/drawing/Tints.h"
#include "ui/pages/CurveKeys.h"
#include "ui/pages/EventText.h"
#include "ui/pages/PageTitle.h"

#include <algorithm>

namespace pallax::terminal {

namespace {

constexpr int kLeastPlotRows = 3;

} // namespace

PageAnswer GraphPage::handle(const KeyEvent& event) {
    if (handleCurveKey(_reading, event)) {
        return PageAnswer::Handled;
    }
    const bool closes = event.key == Key::Character && event.character == U'V';
    return closes || goesBack(event) ? PageAnswer::Closes : PageAnswer::NotMine;
}

Plot GraphPage::plotOf(const GraphPlot& content) const {
    const CurveWindow& window = _shown.window();
    Plot plot{window.from, window.to,       _shown.time().ahead, content.unit,
              {},          _shown.events(), _reading.cursor()};
    for (const GraphCurve& each : content.curves) {
        plot.curves.push_back({each.mark, each.curve, tintOfCurve(each.number)});
    }
    return plot;
}

void GraphPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    Grid& grid = screen.grid;
    Bars bars(grid, screen.marks, screen.hits, around.status);
    drawPageTitle(grid, screen.marks, bars,
                  std::string(around.root).append(screen.marks.crumb) + "Graph");
    (void)bars.drawRule(kRowsAbove - 1, screen.marks.up, 0, Key::PageUp);
    const int columns = grid.columns() - 2 * kMargin;
    const std::vector<GraphPlot> contents =
        graphPlots(_shown, _graph, _reading, static_cast<std::size_t>(columns));
    if (contents.empty()) {
        _reading.fit({}, {}, 0);
        grid.put(kMargin, kRowsAbove, "No values: v in a pane adds one.", {},
                 {kMargin, kMargin + columns});
    } else {
        drawPlots(screen, contents);
    }
    const int ruleRight =
        bars.drawRule(grid.rows() - kRowsBelow, screen.marks.down, 0, Key::PageDown);
    bars.drawLastRow(
        around.items, ruleRight,
        {{"- + zoom", typed(U'+')}, {"V panes", typed(U'V')}, {"? help", typed(U'?')}});
}

void GraphPage::drawPlots(const PageScreen& screen, const std::vector<GraphPlot>& contents) {
    Grid& grid = screen.grid;
    const Span room{kMargin, grid.columns() - kMargin};
    const int columns = room.right - room.left;
    const int end = grid.rows() - kRowsBelow - 1; // the row of the cursor's time
    int legends = 0;
    int labels = 0;
    for (const GraphPlot& content : contents) {
        legends += static_cast<int>(content.curves.size());
        labels = std::max(labels, labelColumns(plotOf(content), grid.rows()));
    }
    const CurveWindow& window = _shown.window();
    const bool hasCurves = _shown.hasCurves();
    _reading.fit(window.from, window.to,
                 hasCurves ? curveColumns(plotOf(contents.front()), columns, labels) : 0);
    const int rows = (end - kRowsAbove - legends) / static_cast<int>(contents.size());
    int y = kRowsAbove;
    for (const GraphPlot& content : contents) {
        for (const GraphCurve& curve : content.curves) {
            if (y < end) {
                grid.put(kMargin, y, curve.mark + "  " + curve.value + "  " + curve.name, {}, room);
                grid.put(kMargin, y, curve.mark, {.tint = tintOfCurve(curve.number)}, room);
                ++y;
            }
        }
        const int height = std::min(std::max(rows, kLeastPlotRows), end - y);
        if (hasCurves && height >= kLeastPlotRows) {
            drawPlot(grid, screen.marks, plotOf(content), {kMargin, y, columns, height}, labels);
            y += height;
        }
    }
    grid.put(kMargin, end, eventWords(graphWords(_shown, _reading), screen.marks), {}, room);
}

} // namespace pallax::terminal
