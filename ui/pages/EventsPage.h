#pragma once

#include "timeline/Event.h"
#include "timeline/Moment.h"
#include "ui/pages/PageTable.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>

namespace pallax::terminal {

/// What happened, the latest first, on one page. Events after the shown instant are dimmed.
class EventsPage {
public:
    struct Surroundings {
        std::function<Moment()> moment;
        std::function<void(std::uint64_t packet)> goTo;
        std::function<std::chrono::seconds()> ahead; ///< local time minus UTC
        PageTable::Copy copy;
    };

    explicit EventsPage(Surroundings surroundings)
        : _surroundings(std::move(surroundings)), _table(_surroundings.copy) {}

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    /// What the table was made of.
    struct Shown {
        const Timeline* timeline;
        std::uint64_t instant;
        std::uint64_t events; ///< including those that were dropped
        std::chrono::seconds ahead;
        bool operator==(const Shown&) const = default;
    };

    void fill(const Marks& marks);
    /// The event of the cursor's row; null without one.
    const Event* selected() const;

    Surroundings _surroundings;
    PageTable _table;
    std::optional<Shown> _shown;
};

} // namespace pallax::terminal
