#include "app/WayToRow.h"

#include "app/PallaxPaneController.h"
#include "platform/ui/NavigationStack.h"

namespace pallax {

namespace {

PallaxPaneController& paneAt(const ui::NavigationStack& panes, std::size_t depth) {
    return dynamic_cast<PallaxPaneController&>(*panes.screens()[depth]);
}

/// The row of a node among its siblings; 0 if it is not one of them.
std::size_t rowOf(const PaneModel& pane, const NodeRef& node) {
    for (std::size_t row = 0; row < pane.totalRows(); ++row) {
        if (pane.nodeAt(row) == node) {
            return row;
        }
    }
    return 0;
}

} // namespace

void openWay(ui::NavigationStack& panes, const std::vector<std::size_t>& place,
             const std::function<void(std::size_t row)>& select) {
    std::size_t depth = 0;
    while (depth + 1 < panes.screens().size() && depth + 1 < place.size() &&
           paneAt(panes, depth).pane().nodeAt(place[depth]) ==
               paneAt(panes, depth + 1).pane().node()) {
        ++depth;
    }
    panes.popTo(depth, false);
    for (; depth + 1 < place.size(); ++depth) {
        select(place[depth]);
        paneAt(panes, depth).didSelectRow(place[depth]);
    }
    select(place.back());
}

std::vector<std::size_t> placeOf(const ui::NavigationStack& panes, std::size_t row) {
    std::vector<std::size_t> place;
    for (std::size_t depth = 1; depth < panes.screens().size(); ++depth) {
        place.push_back(rowOf(paneAt(panes, depth - 1).pane(), paneAt(panes, depth).pane().node()));
    }
    place.push_back(row);
    return place;
}

} // namespace pallax
