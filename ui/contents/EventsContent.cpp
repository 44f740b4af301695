#include "ui/contents/EventsContent.h"

#include "timeline/Timeline.h"

#include <string>
#include <vector>

namespace pallax {

/// A row's key is the number of its event, so that the cursor stays on its event when others come.
TableContent EventsContent::table(const Timeline& timeline, const Shown& shown) const {
    TableContent table{{{"Time", {}, true}, {"Kind"}, {"What"}}, {}, "event", "events"};
    const std::vector<Event>& events = timeline.events();
    table.rows.reserve(events.size());
    for (std::size_t index = events.size(); index-- > 0;) {
        const Event& event = events[index];
        table.rows.push_back({std::to_string(timeline.eventsDropped() + index),
                              {{timeOfDay(event.time, shown.ahead)},
                               {std::string(wordOf(event.kind))},
                               {_surroundings.wording(event.words)}},
                              event.packet > shown.instant});
    }
    return table;
}

void EventsContent::fill(TableModel& table) {
    const Moment moment = _surroundings.moment();
    if (moment.timeline == nullptr) {
        _shown.reset();
        table.update({}, TableModel::Changes::Ignore);
        return;
    }
    const Timeline& timeline = *moment.timeline;
    const Shown now{&timeline, moment.instant, timeline.eventsDropped() + timeline.events().size(),
                    _surroundings.ahead()};
    if (_shown == now) {
        return;
    }
    table.update(this->table(timeline, now), TableModel::Changes::Ignore);
    if (!_shown) {
        std::size_t row = 0;
        while (row + 1 < table.content().rows.size() && table.content().rows[row].isSecondary) {
            ++row;
        }
        table.select(row);
    }
    _shown = now;
}

std::optional<std::uint64_t> EventsContent::selected(const TableModel& table) const {
    const auto row = table.cursorRow();
    const Moment moment = _surroundings.moment();
    if (!row || moment.timeline == nullptr) {
        return std::nullopt;
    }
    const std::uint64_t number = std::stoull(table.content().rows[*row].key);
    const std::uint64_t dropped = moment.timeline->eventsDropped();
    const std::vector<Event>& events = moment.timeline->events();
    const bool isThere = number >= dropped && number - dropped < events.size();
    return isThere ? std::optional(events[number - dropped].packet) : std::nullopt;
}

} // namespace pallax
