#include "overview/StatusWatch.h"

#include "fields/CellFields.h"
#include "platform/RecordedTechnology.h"
#include "timeline/Instants.h"

#include <algorithm>
#include <utility>

namespace pallax {

Overview overviewAt(const Moment& moment, const NetworkNames& names,
                    const QualityProfile& profile) {
    const auto time =
        moment.timeline == nullptr ? std::nullopt : timeOf(*moment.timeline, moment.instant);
    if (!time) {
        return {};
    }
    Overview overview{statusOf(moment.timeline->valuesAt(moment.instant), *time, names, profile),
                      {}};
    const std::vector<Event>& events = moment.timeline->events();
    const auto past = std::upper_bound(
        events.begin(), events.end(), moment.instant,
        [](std::uint64_t instant, const Event& event) { return instant < event.packet; });
    const auto count = std::min<std::ptrdiff_t>(past - events.begin(), StatusWatch::kMostEvents);
    overview.events.assign(past - count, past);
    return overview;
}

StatusWatch::Known::Known(const RecordedTechnology& technology, const Resources& resources)
    : fields(technology, resources), values(fields, entries),
      finder(technology.commandName, fields, entries) {}

void StatusWatch::begin(std::string_view technology) {
    _known.reset();
    if (const RecordedTechnology* known = technologyOfIdentifier(technology)) {
        _known = std::make_unique<Known>(*known, _resources);
        _known->values.setListener(this);
    }
}

bool StatusWatch::identifies(const std::string& path) const {
    const auto field = _known ? _known->fields.atPath(path) : std::nullopt;
    return field && _known->fields.identifies(*field);
}

bool StatusWatch::namesCell(const std::string& path) const {
    const auto field = _known ? _known->fields.atPath(path) : std::nullopt;
    const auto cells = cellFields();
    return field && std::any_of(cells.begin(), cells.end(), [&](const CellFields& cell) {
               return cell.code == _known->fields[*field].name;
           });
}

Overview StatusWatch::overview(Time time, const NetworkNames& names,
                               const QualityProfile& profile) const {
    if (!_known) {
        return {};
    }
    Overview overview{statusOf(_known->values, time, names, profile), _known->events};
    for (StatusCell& cell : overview.status.cells) {
        for (auto* values : {&cell.identity, &cell.levels}) {
            for (StatusValue& value : *values) {
                addPatience(value);
            }
        }
        if (cell.channel) {
            addPatience(*cell.channel);
        }
    }
    return overview;
}

void StatusWatch::addPatience(StatusValue& value) const {
    const auto field = _known->fields.named(value.field);
    if (field && *field < _known->arrivals.size()) {
        value.patience = _known->arrivals[*field].patience();
    }
}

void StatusWatch::valueRead(FieldIndex field, EntryId entry, const FieldValue& value) {
    _known->finder.valueRead(field, value);
    if (entry == kNoEntry) {
        if (field >= _known->arrivals.size()) {
            _known->arrivals.resize(_known->fields.size());
        }
        _known->arrivals[field].note(value.read);
    }
}

void StatusWatch::beginPacket(const SamplePacket& packet) {
    if (!_known) {
        return;
    }
    _known->packet = packet;
    if (_known->stamps.stepTo(packet.time)) {
        _known->finder.noteStep();
    }
    _known->stamps.take(packet.time);
    _known->values.beginPacket(packet);
}

void StatusWatch::endPacket() {
    if (!_known) {
        return;
    }
    _known->finder.endPacket(_known->packet.number, _known->packet.time, _known->values,
                             _known->events);
    forgetEarlyEvents();
}

void StatusWatch::add(Event event) {
    if (_known) {
        _known->events.push_back(std::move(event));
        forgetEarlyEvents();
    }
}

void StatusWatch::forgetEarlyEvents() {
    std::vector<Event>& events = _known->events;
    if (events.size() > kMostEvents) {
        events.erase(events.begin(), events.end() - kMostEvents);
    }
}

} // namespace pallax
