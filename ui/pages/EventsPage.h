#pragma once

#include "ui/contents/EventsContent.h"
#include "ui/pages/PageTable.h"

#include <cstdint>
#include <functional>
#include <utility>

namespace pallax::terminal {

/// What happened, the latest first, on one page. Events after the shown instant are dimmed.
class EventsPage {
public:
    struct Surroundings {
        EventsContent::Surroundings events;
        std::function<void(std::uint64_t packet)> goTo;
        PageTable::Copy copy;
    };

    explicit EventsPage(Surroundings surroundings)
        : _goTo(std::move(surroundings.goTo)), _content(std::move(surroundings.events)),
          _table(std::move(surroundings.copy)) {}

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    std::function<void(std::uint64_t packet)> _goTo;
    EventsContent _content;
    PageTable _table;
};

} // namespace pallax::terminal
