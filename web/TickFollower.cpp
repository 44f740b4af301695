#include "web/TickFollower.h"

#include "timeline/Replay.h"
#include "timeline/Timeline.h"

namespace pallax {

TickFollower::TickFollower(Timeline& timeline)
    : _timeline(timeline), _values(timeline.fieldTable(), timeline.entryTable()) {}

TickFollower::~TickFollower() = default;

bool TickFollower::follow(const Tell& tell, const std::function<bool()>& mayContinue) {
    if (_replay == nullptr) {
        const TimelineKeyFrame* from = _timeline.keyFrames().atOrBefore(_timeline.firstInstant());
        if (from == nullptr) {
            return true;
        }
        _replay = _timeline.replayFrom(from->decoder, from->packet);
        _reader = _timeline.journal().reader(from->packet + 1);
        _grid = from->grid;
        _values.take(from->values);
        _shown.packet = from->packet;
    }
    while (_replay->packet() < _timeline.packets()) {
        if (!mayContinue()) {
            return false;
        }
        const auto packet = _reader->next();
        if (!packet) {
            break;
        }
        if (const auto passed = _grid.passedBefore(packet->time)) {
            show(*passed, tell);
        }
        _replay->update(*packet, &_values);
    }
    return true;
}

void TickFollower::settle(const Tell& tell) {
    if (_replay != nullptr && _replay->packet() > 0) {
        show(_grid.next(), tell);
    }
}

/// A tick that was told before a packet for it came after all is not told again: what is new is
/// shown by the next one.
void TickFollower::show(const TickGrid::Tick& tick, const Tell& tell) {
    if (_replay->packet() > _shown.packet && tick.number > _shown.tick.number) {
        _shown = {tick, _replay->packet()};
        tell(_shown, _values);
    }
}

} // namespace pallax
