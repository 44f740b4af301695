#include "timeline/FrameWalk.h"

#include <algorithm>
#include <utility>

namespace pallax {

std::optional<InstantFrame> FrameWalk::at(std::uint64_t instant) {
    const std::optional<Time> time = timeOf(_timeline, instant);
    if (!time || instant == 0) {
        return std::nullopt;
    }
    InstantFrame made;
    if (const auto before = tickBefore(_timeline, instant)) {
        made.before = frameOf(*replayAt(before->packet), before->tick.time, nullptr);
    }
    made.frame = frameOf(*replayAt(instant), *time, made.before);
    return made;
}

/// Decodes from the nearest place, and leaves places on the way.
std::unique_ptr<Replay> FrameWalk::replayAt(std::uint64_t instant) {
    const TimelineKeyFrame& key = *_timeline.keyFrames().atOrBefore(instant);
    if (_from != key.packet) {
        _places.clear();
        _from = key.packet;
    }
    const auto past = std::upper_bound(
        _places.begin(), _places.end(), instant,
        [](std::uint64_t packet, const Place& place) { return packet < place.packet; });
    std::unique_ptr<Replay> replay =
        past == _places.begin() ? _timeline.replayFrom(key.decoder, key.packet)
                                : _timeline.replayFrom((past - 1)->decoder, (past - 1)->packet);
    const TimelineKeyFrame* next = _timeline.keyFrames().after(key.packet);
    const std::uint64_t end = next != nullptr ? next->packet : _timeline.packets();
    const std::uint64_t distance = std::max((end - key.packet) / kPlaces, kLeastDistance);
    while (replay->packet() < instant) {
        const std::uint64_t target = std::min(replay->packet() + distance, instant);
        _timeline.advance(*replay, target);
        if (replay->packet() < target) {
            break; // the journal does not have the packet any more
        }
        if (_places.empty() || _places.back().packet + distance <= target) {
            _places.push_back({target, replay->keyFrame()});
        }
    }
    return replay;
}

} // namespace pallax
