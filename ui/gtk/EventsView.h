#pragma once

#include "ui/contents/EventsContent.h"
#include "ui/gtk/TablePage.h"

#include <cstdint>
#include <functional>

namespace pallax::gtk {

/// The page of what happened, the latest first.
class EventsView {
public:
    struct Surroundings {
        EventsContent::Surroundings events;
        std::function<void(std::uint64_t packet)> goTo; ///< an event was chosen
    };

    EventsView(const PangoMetrics& metrics, const Guard& guard, Surroundings surroundings);

    /// Other events have come, or another instant is shown.
    void refresh();
    TableView& table() { return _page.table(); }
    GtkWidget* widget() const { return _page.widget(); }

private:
    void open();

    std::function<void(std::uint64_t packet)> _goTo;
    EventsContent _content;
    TablePage _page;
};

} // namespace pallax::gtk
