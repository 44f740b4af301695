#include "store/RecordingMeasurements.h"

#include "fields/Measures.h"
#include "fields/StatusFields.h"
#include "platform/RecordedTechnology.h"
#include "platform/SystemLog.h"

#include <algorithm>
#include <exception>
#include <map>

namespace pallax {

namespace {

std::chrono::sys_time<std::chrono::milliseconds> inMilliseconds(Time time) {
    return std::chrono::floor<std::chrono::milliseconds>(time);
}

} // namespace

std::string_view wordOf(Resolution resolution) {
    return resolution == Resolution::Tick ? "tick" : "packet";
}

RecordingMeasurements::RecordingMeasurements(const DecodingSource& source, Resolution resolution,
                                             Take take)
    : _resources(source.resources), _fields(source.technology, _resources),
      _values(_fields, _entries),
      _replay({source.technology, _resources, source.bundle, source.technologies}),
      _eventFinder(source.technology.commandName, _fields, _entries), _cells(_fields, _entries),
      _resolution(resolution), _take(std::move(take)) {
    _values.setListener(this);
    findLevels(source.technology.commandName);
}

bool RecordingMeasurements::add(const JournalPacket& packet) {
    const auto tick = _grid.passedBefore(packet.time);
    if (tick && _resolution == Resolution::Tick) {
        showTick(*tick);
    }
    noteStep(packet);
    _packet = packet;
    _items.clear();
    _mayNameCell = false;
    if (_resolution == Resolution::Packet) {
        _spans.beginPacket(packet.number, packet.time);
    }
    try {
        _replay.update(packet, &_values);
    } catch (const std::exception& error) {
        _events.push_back({EventKind::FatalRecord,
                           packet.time,
                           packet.number,
                           "fatal record: " + std::string(error.what()),
                           {}});
        return false;
    }
    _eventFinder.endPacket(packet.number, packet.time, _values, _events);
    if (_mayNameCell) {
        _cells.take(_items);
        if (_resolution == Resolution::Packet) {
            noteServing(packet.number, packet.time);
        }
    }
    handOut();
    return true;
}

void RecordingMeasurements::finish() {
    if (_resolution == Resolution::Tick && _replay.packet() > 0) {
        showTick(_grid.next());
    }
    _spans.endAll();
    handOut();
}

void RecordingMeasurements::noteStep(const JournalPacket& packet) {
    const auto& step = _grid.step();
    if (step && step->kind != StampRemark::Kind::OutOfRange) {
        _events.push_back(EventFinder::eventOf(*step, packet.number, packet.time));
        _eventFinder.noteStep();
        _spans.endAll(); // what was between is unknown
        handOut();
    }
}

void RecordingMeasurements::valueRead(FieldIndex field, EntryId entry, const FieldValue& value) {
    _eventFinder.valueRead(field, value);
    _mayNameCell = _mayNameCell || _cells.isWatched(field);
    const auto place = static_cast<std::uint32_t>(_items.size());
    _items.push_back({_packet.number, _packet.time, field, entry, value, place});
    if (_resolution == Resolution::Packet) {
        _spans.valueRead(field, entry, value);
    }
}

void RecordingMeasurements::valueRemoved(FieldIndex field) {
    _eventFinder.valueRemoved(field);
    if (_resolution == Resolution::Packet) {
        _spans.valueRemoved(field);
    }
}

void RecordingMeasurements::listReplaced(ListId list) {
    _eventFinder.listReplaced(list);
    if (_resolution == Resolution::Packet) {
        _spans.listReplaced(list);
    }
}

/// The values that the display shows are all that there are at a tick.
void RecordingMeasurements::showTick(const TickGrid::Tick& tick) {
    if (_replay.packet() <= _shown) {
        return;
    }
    _shown = _replay.packet();
    noteServing(_shown, tick.time);
    _spans.beginPacket(_shown, tick.time);
    for (FieldIndex field = 0; field < _values.fieldCount(); ++field) {
        const FieldValue* value = _values.value(field);
        if (value != nullptr && isKnown(field, *value, tick.time)) {
            _spans.valueRead(field, kNoEntry, *value);
        }
    }
    _values.forEachEntry([&](const EntryValues& entry) {
        for (const auto& [field, value] : entry.values) {
            if (isKnown(field, value, tick.time)) {
                _spans.valueRead(field, entry.entry, value);
            }
        }
    });
    _spans.endUnread();
    handOut();
}

void RecordingMeasurements::findLevels(std::string_view technology) {
    for (const MeasuredField& measured : measuredFields()) {
        if (const auto field = _fields.named(measured.name)) {
            _levels.resize(std::max<std::size_t>(_levels.size(), *field + std::size_t{1}));
            _levels[*field].isOne = true;
        }
    }
    for (const StatusCellFields& cell : statusCells()) {
        std::map<std::string_view, std::vector<FieldIndex>> byName;
        for (const StatusField& each : cell.fields) {
            const auto field = _fields.named(each.field);
            if (cell.technology == technology && each.role == StatusField::Role::Level && field &&
                *field < _levels.size()) {
                byName[each.name].push_back(*field);
            }
        }
        for (const auto& [name, fields] : byName) {
            for (const FieldIndex field : fields) {
                _levels[field].others = fields;
            }
        }
    }
}

bool RecordingMeasurements::isKnown(FieldIndex field, const FieldValue& value, Time now) const {
    if (field >= _levels.size() || !_levels[field].isOne) {
        return true;
    }
    const auto& others = _levels[field].others;
    return now - value.read <= kLevelHolds &&
           std::none_of(others.begin(), others.end(), [&](FieldIndex other) {
               const FieldValue* its = _values.value(other);
               return its != nullptr && its->read > value.read;
           });
}

void RecordingMeasurements::noteServing(std::uint64_t packet, Time time) {
    const auto serving = _cells.serving();
    if (serving && (_served.empty() || _served.back().cell != *serving)) {
        _served.push_back({packet, time, *serving});
    }
}

void RecordingMeasurements::handOut() {
    for (const Span& span : _spans.ended()) {
        divide(span);
    }
    _spans.ended().clear();
}

/// A span becomes an interval for each cell that served during its time.
void RecordingMeasurements::divide(const Span& span) {
    auto next = std::upper_bound(
        _served.begin(), _served.end(), span.packet,
        [](std::uint64_t packet, const Served& served) { return packet < served.packet; });
    Interval interval{span.field, span.entry, span.value, span.packet, span.start, {}, {}};
    interval.cell = next != _served.begin() ? std::optional(std::prev(next)->cell) : std::nullopt;
    interval.whole = inMilliseconds(span.end) - inMilliseconds(span.start);
    for (; next != _served.end() && next->time < span.end; ++next) {
        if (next->time > interval.start) {
            interval.hold = inMilliseconds(next->time) - inMilliseconds(interval.start);
            interval.part = interval.part == Interval::Part::Continued ? Interval::Part::Continued
                                                                       : Interval::Part::First;
            _take(interval);
            interval.part = Interval::Part::Continued;
            interval.start = next->time;
            interval.packet = next->packet;
        }
        interval.cell = next->cell;
    }
    interval.hold = inMilliseconds(span.end) - inMilliseconds(interval.start);
    _take(interval);
}

} // namespace pallax
