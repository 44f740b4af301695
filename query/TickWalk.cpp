#include "query/TickWalk.h"

#include "query/TimelineTables.h"
#include "timeline/Timeline.h"

#include <algorithm>
#include <utility>

namespace pallax {

TickWalk::TickWalk(Timeline& timeline, const TimelineKeyFrame& from)
    : _timeline(timeline), _replay(timeline.replayFrom(from.decoder, from.packet)),
      _reader(timeline.journal().reader(from.packet + 1)),
      _grid(from.grid), _now{.values = {timeline.fieldTable(), timeline.entryTable()}},
      _from(from.packet) {
    _now.values.take(from.values);
    _now.packet = from.ticks.empty() ? 0 : from.ticks.back().packet;
}

bool TickWalk::next(const PacketRange& range, bool keepsCurrent) {
    if (_isAtTick) {
        leave(keepsCurrent);
    }
    while (!_hasEnded) {
        if (_held) {
            _replay->update(*std::exchange(_held, std::nullopt), &_now.values);
        }
        range.noteRead(_replay->packet() + 1);
        _held = _reader->next();
        _hasEnded = !_held || _held->number > _timeline.packets();
        if (_hasEnded) {
            // The tick after the last packet.
            return _replay->packet() > 0 && stopsAt(_grid.next());
        }
        const auto passed = _grid.passedBefore(_held->time);
        if (passed && stopsAt(*passed)) {
            return true;
        }
    }
    return false;
}

/// Stops only where there is new data.
bool TickWalk::stopsAt(const TickGrid::Tick& tick) {
    _isAtTick = _replay->packet() > _now.packet;
    if (_isAtTick) {
        _now.tick = tick;
        _now.packet = _replay->packet();
    }
    return _isAtTick;
}

void TickWalk::leave(bool keeps) {
    _isAtTick = false;
    if (!keeps) {
        return lose(_now);
    }
    _kept.push_back(_now);
    if (_kept.size() > kMostKept) {
        lose(_kept.front());
        _kept.pop_front();
    }
}

void TickWalk::lose(const State& state) {
    _lostPacket = std::max(_lostPacket, state.packet);
    _lostTime = std::max(_lostTime, microseconds(state.tick.time));
}

} // namespace pallax
