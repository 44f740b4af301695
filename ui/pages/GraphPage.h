#pragma once

#include "ui/pages/CurveKeys.h"
#include "ui/pages/Graph.h"
#include "ui/pages/Page.h"
#include "ui/pages/ShownValues.h"

#include <string>
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
    /// A plot with the rows of its legend.
    struct Group {
        Plot plot;
        std::vector<std::string> legend;
    };

    std::vector<Group> groups(int columns);
    std::string legendOf(const LeafName& leaf, const FieldInfo& field, const PlotCurve& curve,
                         const CurrentValues& values) const;
    void drawGroups(const PageScreen& screen, std::vector<Group> groups);

    ShownValues& _shown;
    const Graph& _graph;
    CurveKeys _keys;
};

} // namespace pallax::terminal
