#include "ui/pages/EventsPage.h"

#include "timeline/Timeline.h"
#include "ui/pages/EventText.h"

#include <string>

namespace pallax::terminal {

namespace {

constexpr std::string_view kNoEvents = "No events yet.";

/// The events, the latest first. A row's key is the number of its event, so that the cursor stays
/// on its event when others come.
TableContent eventTable(const Timeline& timeline, std::uint64_t instant, std::chrono::seconds ahead,
                        const Marks& marks) {
    TableContent table{{{"Time", {}, true}, {"Kind"}, {"What"}}, {}, "event", "events"};
    const std::vector<Event>& events = timeline.events();
    table.rows.reserve(events.size());
    for (std::size_t index = events.size(); index-- > 0;) {
        const Event& event = events[index];
        table.rows.push_back({std::to_string(timeline.eventsDropped() + index),
                              {{eventTime(event.time, ahead)},
                               {std::string(wordOf(event.kind))},
                               {eventWords(event.words, marks)}},
                              event.packet > instant});
    }
    return table;
}

} // namespace

/// The first time, the cursor is on the latest event at the shown instant.
void EventsPage::fill(const Marks& marks) {
    const Moment moment = _surroundings.moment();
    if (moment.timeline == nullptr) {
        _shown.reset();
        _table.model().update({}, TableModel::Changes::Ignore);
        return;
    }
    const Timeline& timeline = *moment.timeline;
    const Shown now{&timeline, moment.instant, timeline.eventsDropped() + timeline.events().size(),
                    _surroundings.ahead()};
    if (_shown == now) {
        return;
    }
    TableModel& model = _table.model();
    model.update(eventTable(timeline, now.instant, now.ahead, marks), TableModel::Changes::Ignore);
    if (!_shown) {
        std::size_t row = 0;
        while (row + 1 < model.content().rows.size() && model.content().rows[row].isSecondary) {
            ++row;
        }
        model.select(row);
    }
    _shown = now;
}

const Event* EventsPage::selected() const {
    const auto row = _table.model().cursorRow();
    const Moment moment = _surroundings.moment();
    if (!row || moment.timeline == nullptr) {
        return nullptr;
    }
    const std::uint64_t number = std::stoull(_table.model().content().rows[*row].key);
    const std::uint64_t dropped = moment.timeline->eventsDropped();
    const std::vector<Event>& events = moment.timeline->events();
    const bool isThere = number >= dropped && number - dropped < events.size();
    return isThere ? &events[number - dropped] : nullptr;
}

PageAnswer EventsPage::handle(const KeyEvent& event) {
    if (!_table.isTyping()) {
        if (event.key == Key::Enter) {
            const Event* const chosen = selected();
            if (chosen == nullptr) {
                return PageAnswer::Handled;
            }
            _surroundings.goTo(chosen->packet);
            return PageAnswer::Closes;
        }
        if (event.key == Key::Character && event.character == U'e') {
            return PageAnswer::Closes;
        }
    }
    return _table.handle(event);
}

void EventsPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    fill(screen.marks);
    std::vector<Hint> hints;
    if (_table.model().cursorRow()) {
        hints = {{"e panes", typed(U'e')}, {"Enter go there", {.key = Key::Enter}}};
    }
    _table.draw(screen, around, {"Events", kNoEvents, std::move(hints)});
}

} // namespace pallax::terminal
