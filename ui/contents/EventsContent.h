#pragma once

#include "app/table/TableModel.h"
#include "timeline/Moment.h"
#include "ui/contents/TimeOfDay.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>

namespace pallax {

/// What happened as a table, the latest first. Events after the shown instant are secondary.
class EventsContent {
public:
    struct Surroundings {
        std::function<Moment()> moment;
        std::function<std::chrono::seconds()> ahead; ///< local time minus UTC
        Wording wording = sameWords;
    };

    explicit EventsContent(Surroundings surroundings) : _surroundings(std::move(surroundings)) {}

    /// Fills the table again if other events or another instant are shown. The first time, the
    /// cursor goes to the latest event at the shown instant.
    void fill(TableModel& table);
    /// The packet of the event under the cursor; nothing without one.
    std::optional<std::uint64_t> selected(const TableModel& table) const;

private:
    /// What the table was made of.
    struct Shown {
        const Timeline* timeline;
        std::uint64_t instant;
        std::uint64_t events; ///< including those that were dropped
        std::chrono::seconds ahead;
        bool operator==(const Shown&) const = default;
    };

    TableContent table(const Timeline& timeline, const Shown& shown) const;

    Surroundings _surroundings;
    std::optional<Shown> _shown;
};

} // namespace pallax
