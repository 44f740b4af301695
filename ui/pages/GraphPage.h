#pragma once

#include "ui/contents/GraphContent.h"
#include "ui/drawing/Plot.h"
#include "ui/pages/Page.h"

#include <vector>

namespace pallax::terminal {

/// The curves of several values: one plot for each unit, below each other.
class GraphPage {
public:
    /// Both must outlive the page.
    GraphPage(ShownValues& shown, const Graph& graph) : _shown(shown), _graph(graph) {}

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    Plot plotOf(const GraphPlot& content) const;
    void drawPlots(const PageScreen& screen, const std::vector<GraphPlot>& contents);

    ShownValues& _shown;
    const Graph& _graph;
    CurveReading _reading;
};

} // namespace pallax::terminal
