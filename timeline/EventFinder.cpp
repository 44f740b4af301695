#include "timeline/EventFinder.h"

#include "text/Format.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace pallax {

namespace {

using namespace std::chrono_literals;
using Watch = EventFields::Watch;

constexpr std::string_view kArrow = " → ";
/// Of several records that tell of a new cell, the later ones come soon after the first.
constexpr std::chrono::seconds kSettling{5};

bool isAmong(std::span<const std::string_view> values, std::string_view value) {
    return std::find(values.begin(), values.end(), value) != values.end();
}

std::string textOf(const CurrentValues& values, FieldIndex field) {
    const FieldValue* value = values.value(field);
    return value != nullptr ? value->text() : std::string();
}

std::vector<std::string> textsOf(const CurrentValues& values,
                                 const std::vector<FieldIndex>& fields) {
    std::vector<std::string> texts;
    texts.reserve(fields.size());
    for (const FieldIndex field : fields) {
        texts.push_back(textOf(values, field));
    }
    return texts;
}

std::string joined(const std::vector<std::string>& texts) {
    std::string all;
    for (const std::string& text : texts) {
        all.append(all.empty() || text.empty() ? "" : "/").append(text);
    }
    return all;
}

} // namespace

std::string contextName(const PropertyList& context) {
    const DictionaryRef keys = context.dictionary();
    const PropertyList* name = keys != nullptr ? keys->find("APN") : nullptr;
    const auto text = name != nullptr ? name->string() : std::nullopt;
    return text ? *text : context.string().value_or(context.description());
}

EventFinder::EventFinder(std::string_view technology, const FieldTable& fields, EntryTable& entries,
                         std::chrono::nanoseconds pingPong)
    : _pingPong(pingPong) {
    for (const EventFields& rule : eventFields()) {
        if (rule.technology != technology) {
            continue;
        }
        Row row{&rule, {}, false, {}, {}, {}, false, {}};
        for (const std::string_view name : rule.fields) {
            const auto field = fields.named(name);
            if (!field) {
                continue;
            }
            row.fields.push_back(*field);
            _watched.resize(std::max(_watched.size(), *field + std::size_t{1}));
            _watched[*field].isWatched = true;
            if (rule.watch == Watch::Contexts) {
                _contexts = entries.list(fields[*field].section, "", 0);
            }
        }
        if (row.fields.size() == rule.fields.size()) {
            _rows.push_back(std::move(row));
        }
    }
}

void EventFinder::noteValue(Watched& watched, const FieldValue& value) {
    if (!(watched.latest == value.shown)) {
        watched.latest = value.shown;
        _hasChanged = true;
    }
}

void EventFinder::endPacket(std::uint64_t packet, Time time, const CurrentValues& values,
                            std::vector<Event>& events) {
    if (!std::exchange(_hasChanged, false)) {
        return;
    }
    const Moment moment{packet, time, values, events};
    for (Row& row : _rows) {
        look(row, moment);
    }
}

void EventFinder::look(Row& row, const Moment& moment) {
    switch (row.rule->watch) {
    case Watch::Cell:
        return lookAtCell(row, moment);
    case Watch::State:
    case Watch::Technology:
        return lookAtState(row, moment);
    case Watch::Service:
        return lookAtService(row, moment);
    case Watch::Contexts:
        return lookAtContexts(row, moment);
    }
}

bool EventFinder::isOvershadowed(const Row& row, const Moment& moment) const {
    return std::any_of(_rows.begin(), _rows.end(), [&](const Row& other) {
        return &other < &row && other.isKnown && other.rule->subject == row.rule->subject &&
               other.rule->watch == row.rule->watch &&
               !textOf(moment.values, other.fields.front()).empty();
    });
}

void EventFinder::lookAtCell(Row& row, const Moment& moment) {
    std::vector<std::string> cell = textsOf(moment.values, row.fields);
    if (cell.front().empty() || isAmong(row.rule->bad, cell.front())) {
        return; // no cell is named
    }
    const bool isSame = row.isKnown && cell.front() == row.value.front();
    for (std::size_t index = 1; isSame && index < cell.size(); ++index) {
        cell[index] = cell[index].empty() ? row.value[index] : cell[index];
    }
    if (cell == row.value) {
        return;
    }
    const bool isCompleted =
        isSame && std::find(row.value.begin(), row.value.end(), "") != row.value.end();
    if (isCompleted || (isSame && timeSince(row, moment) <= kSettling)) {
        row.value = std::move(cell);
        return;
    }
    if (row.isKnown && !isOvershadowed(row, moment)) {
        const bool isBack = cell == row.before && timeSince(row, moment) <= _pingPong;
        std::string words(row.rule->subject);
        words.append(" ").append(isSame ? joined(row.value) : row.value.front());
        words.append(kArrow).append(isSame ? joined(cell) : cell.front());
        words.append(dwell(row, moment)).append(isBack ? " (ping-pong)" : "");
        add(row, isBack ? EventKind::PingPong : EventKind::CellChange, std::move(words), moment);
    }
    row.before = std::exchange(row.value, std::move(cell));
    row.since = moment.time;
    row.isInterrupted = false;
    row.isKnown = true;
}

void EventFinder::lookAtState(Row& row, const Moment& moment) {
    std::vector<std::string> state = textsOf(moment.values, row.fields);
    if (state == row.value || state.front().empty() || isAmong(row.rule->bad, state.front())) {
        return;
    }
    if (row.rule->watch == Watch::Technology) {
        if (isAmong(row.rule->good, state.front())) {
            add(row, EventKind::TechnologyChange, "technology " + std::string(row.rule->subject),
                moment);
        }
    } else if (row.isKnown && !(isAmong(row.rule->good, row.value.front()) &&
                                isAmong(row.rule->good, state.front()))) {
        std::string words(row.rule->subject);
        words.append(" ").append(row.value.front()).append(kArrow).append(state.front());
        add(row, EventKind::StateChange, std::move(words), moment);
    }
    row.value = std::move(state);
    row.isKnown = true;
}

void EventFinder::lookAtService(Row& row, const Moment& moment) {
    const std::string value = textOf(moment.values, row.fields.front());
    const bool isBad = value.empty() || isAmong(row.rule->bad, value);
    const bool isGood =
        !value.empty() && (row.rule->good.empty() || isAmong(row.rule->good, value));
    if ((!isBad && !isGood) || row.isGood == isGood || (value.empty() && !row.isGood)) {
        return;
    }
    if (row.isGood) {
        const std::string cause = value.empty() || row.rule->good.empty() ? "" : ": " + value;
        add(row, isGood ? EventKind::ServiceRegained : EventKind::ServiceLost,
            std::string(row.rule->subject) + (isGood ? " regained" : " lost") + cause +
                dwell(row, moment),
            moment);
    }
    row.isGood = isGood;
    row.since = moment.time;
    row.isInterrupted = false;
}

void EventFinder::lookAtContexts(Row& row, const Moment& moment) {
    std::vector<std::string> names;
    bool isRead = row.isKnown;
    moment.values.forEachEntry([&](const EntryValues& entry) {
        for (const auto& [field, value] : entry.values) {
            if (field == row.fields.front()) {
                names.push_back(contextName(value.shown));
                isRead = true;
            }
        }
    });
    std::sort(names.begin(), names.end());
    const auto tell = [&](const std::vector<std::string>& some,
                          const std::vector<std::string>& others, EventKind kind,
                          std::string_view what) {
        std::vector<std::string> only;
        std::set_difference(some.begin(), some.end(), others.begin(), others.end(),
                            std::back_inserter(only));
        for (const std::string& name : only) {
            std::string words(row.rule->subject);
            add(row, kind, words.append(what).append(name), moment);
        }
    };
    if (row.isKnown) {
        tell(row.value, names, EventKind::ContextDown, " down: ");
        tell(names, row.value, EventKind::ContextUp, " up: ");
    }
    row.isKnown = isRead;
    row.value = std::move(names);
}

void EventFinder::add(const Row& row, EventKind kind, std::string words, const Moment& moment) {
    moment.events.push_back({kind,
                             moment.time,
                             moment.packet,
                             std::move(words),
                             {row.rule->fields.begin(), row.rule->fields.end()}});
}

void EventFinder::noteStep() {
    for (Row& row : _rows) {
        row.isInterrupted = true;
    }
}

std::chrono::nanoseconds EventFinder::timeSince(const Row& row, const Moment& moment) {
    return row.isInterrupted || moment.time < row.since ? std::chrono::nanoseconds::max()
                                                        : moment.time - row.since;
}

std::string EventFinder::dwell(const Row& row, const Moment& moment) {
    const auto time = timeSince(row, moment);
    return time == std::chrono::nanoseconds::max()
               ? std::string()
               : formatText(" after %lld s",
                            {std::chrono::round<std::chrono::seconds>(time).count()});
}

Event EventFinder::eventOf(const StampRemark& step, std::uint64_t packet, Time time) {
    const double seconds = std::chrono::duration<double>(step.size).count();
    const bool isGap = step.kind == StampRemark::Kind::Gap;
    return {isGap ? EventKind::Gap : EventKind::TimeStep,
            time,
            packet,
            formatText(isGap ? "no packets for %.1f s" : "time steps back %.1f s", {seconds}),
            {}};
}

} // namespace pallax
