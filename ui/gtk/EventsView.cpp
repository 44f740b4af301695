#include "ui/gtk/EventsView.h"

#include "ui/gtk/Translation.h"

#include <utility>

namespace pallax::gtk {

EventsView::EventsView(const PangoMetrics& metrics, const Guard& guard, Surroundings surroundings)
    : _goTo(std::move(surroundings.goTo)), _content(std::move(surroundings.events)),
      _page(metrics, guard, [this] { open(); }) {
    table().setName(translated("Events"));
}

void EventsView::refresh() {
    _content.fill(_page.model());
    _page.show(_page.model().content().rows.empty() ? translated("No events yet.") : "");
}

void EventsView::open() {
    if (const auto packet = _content.selected(_page.model())) {
        _goTo(*packet);
    }
}

} // namespace pallax::gtk
