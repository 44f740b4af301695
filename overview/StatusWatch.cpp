#include "overview/StatusWatch.h"

#include "platform/RecordedTechnology.h"

#include <algorithm>

namespace pallax {

StatusWatch::Known::Known(const RecordedTechnology& technology, const Resources& resources)
    : fields(technology, resources), values(fields, entries),
      finder(technology.commandName, fields, entries) {}

void StatusWatch::begin(std::string_view technology) {
    _known.reset();
    const auto all = recordedTechnologies();
    const auto found = std::find_if(all.begin(), all.end(), [technology](const auto& each) {
        return each.identifier == technology;
    });
    if (found != all.end()) {
        _known = std::make_unique<Known>(*found, _resources);
        _known->values.setListener(this);
    }
}

Overview StatusWatch::overview(Time time, const NetworkNames& names,
                               const QualityProfile& profile) const {
    Overview overview;
    if (_known) {
        overview.status = statusOf(_known->values, time, names, profile);
        overview.events = _known->events;
    }
    return overview;
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
    std::vector<Event>& events = _known->events;
    _known->finder.endPacket(_known->packet.number, _known->packet.time, _known->values, events);
    if (events.size() > kMostEvents) {
        events.erase(events.begin(), events.end() - kMostEvents);
    }
}

} // namespace pallax
