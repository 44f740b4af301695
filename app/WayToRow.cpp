#include "app/WayToRow.h"

#include "app/PallaxPaneController.h"
#include "platform/ui/NavigationStack.h"

namespace pallax {

namespace {

PallaxPaneController& paneAt(const ui::NavigationStack& panes, std::size_t depth) {
    return dynamic_cast<PallaxPaneController&>(*panes.screens()[depth]);
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

} // namespace pallax
