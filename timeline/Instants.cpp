#include "timeline/Instants.h"

#include "LogGenerator/SectionAges.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

/// The ticks of the packets from a key frame on, without decoding them.
class TickSearch {
public:
    TickSearch(const TimelineKeyFrame& from, std::uint64_t firstPacket, Time time)
        : _grid(from.grid), _ticks(from.ticks), _firstPacket(firstPacket), _time(time) {}

    /// False when the search is over.
    bool add(const JournalPacket& packet) {
        const auto tick = _grid.passedBefore(packet.time);
        _latest = packet.number;
        return !tick || addTick(*tick, packet.number - 1);
    }
    /// The packets have ended.
    void end() {
        if (_latest != 0) {
            (void)addTick(_grid.next(), _latest);
        }
    }
    std::vector<ShownTick> ticks() const { return _ticks; }

private:
    bool addTick(const TickGrid::Tick& tick, std::uint64_t packet) {
        const bool isOfStretch = packet >= _firstPacket;
        if (isOfStretch && tick.time > _time) {
            return false;
        }
        if (_ticks.size() == 2) {
            _ticks.erase(_ticks.begin());
        }
        _ticks.push_back({tick, packet});
        return true;
    }

    TickGrid _grid;
    std::vector<ShownTick> _ticks;
    std::uint64_t _firstPacket;
    Time _time;
    std::uint64_t _latest = 0;
};

/// The latest key frame from which the ticks up to that time are found.
const TimelineKeyFrame* startOf(const Timeline& timeline, const Stretch& stretch, Time time) {
    const TimelineKeyFrame* start = nullptr;
    for (const TimelineKeyFrame& frame : timeline.keyFrames().all()) {
        const bool isBefore = frame.packet < stretch.firstPacket;
        const bool isIn =
            &stretch == &timeline.stretches().back() || frame.packet < (&stretch + 1)->firstPacket;
        if (isBefore || (isIn && frame.latest <= time)) {
            start = &frame;
        }
    }
    return start;
}

/// Calls `visit` (ShownTick -> whether to continue) with the two latest ticks of a key frame and
/// with those after it.
template <class Visit>
void forEachTick(Timeline& timeline, const TimelineKeyFrame& from, const Visit& visit) {
    for (const ShownTick& tick : from.ticks) {
        if (!visit(tick)) {
            return;
        }
    }
    TickGrid grid = from.grid;
    std::uint64_t latest = from.packet;
    const auto reader = timeline.journal().reader(from.packet + 1);
    while (latest < timeline.packets()) {
        const auto packet = reader->next();
        if (!packet) {
            break;
        }
        const auto tick = grid.passedBefore(packet->time);
        if (tick && !visit(ShownTick{*tick, packet->number - 1})) {
            return;
        }
        latest = packet->number;
    }
    if (latest > from.packet) {
        (void)visit(ShownTick{grid.next(), latest});
    }
}

} // namespace

std::vector<ShownTick> ticksAt(Timeline& timeline, Time time) {
    const Stretch* stretch = timeline.stretchOf(time);
    const TimelineKeyFrame* start =
        stretch != nullptr ? startOf(timeline, *stretch, time) : nullptr;
    if (start == nullptr) {
        return {};
    }
    const bool isLast = stretch == &timeline.stretches().back();
    const std::uint64_t end = isLast ? timeline.packets() : (stretch + 1)->firstPacket;
    TickSearch search(*start, stretch->firstPacket, time);
    const auto reader = timeline.journal().reader(start->packet + 1);
    for (;;) {
        const auto packet = reader->next();
        if (!packet || packet->number > end) {
            search.end();
            break;
        }
        if (!search.add(*packet) || (!isLast && packet->number == end)) {
            break; // the first packet of the next stretch ends this one
        }
    }
    return search.ticks();
}

FrameRef frameOf(Replay& replay, Time time, const FrameRef& before) {
    const auto paths = std::make_shared<PathDictionary>();
    NodeRef root = PallaxModelNode::makeTreeFromObject(replay.displayAt(time), *paths);
    const SectionAges ages = replay.ages();
    return std::make_shared<Frame>(Frame::Picture{std::move(root), paths, time}, before.get(),
                                   &ages);
}

std::optional<TickFrame> frameAt(Timeline& timeline, Time time) {
    const std::vector<ShownTick> ticks = ticksAt(timeline, time);
    if (ticks.empty() || ticks.front().packet < timeline.firstInstant()) {
        return std::nullopt;
    }
    std::unique_ptr<Replay> replay = timeline.replayAt(ticks.front().packet);
    TickFrame made{frameOf(*replay, ticks.front().tick.time, nullptr), nullptr, ticks.back().tick,
                   ticks.back().packet};
    if (ticks.size() == 2) {
        const TimelineKeyFrame* nearest = timeline.keyFrames().atOrBefore(ticks.back().packet);
        if (nearest != nullptr && nearest->packet > replay->packet()) {
            replay = timeline.replayAt(ticks.back().packet);
        } else {
            timeline.advance(*replay, ticks.back().packet);
        }
        made.before = std::exchange(made.frame, nullptr);
        made.frame = frameOf(*replay, ticks.back().tick.time, made.before);
    }
    return made;
}

std::optional<Time> timeOf(Timeline& timeline, std::uint64_t instant) {
    const auto packet = timeline.journal().reader(std::max<std::uint64_t>(instant, 1))->next();
    return packet ? std::optional(packet->time) : std::nullopt;
}

std::uint64_t instantBeside(Timeline& timeline, std::uint64_t instant, Time time) {
    const std::uint64_t first = timeline.firstInstant();
    const Stretch* stretch = timeline.stretchOfInstant(instant);
    if (stretch == nullptr) {
        return instant;
    }
    if (time < stretch->first) {
        return std::max(stretch->firstPacket - 1, first);
    }
    if (time > stretch->latest && stretch != &timeline.stretches().back()) {
        return std::max((stretch + 1)->firstPacket, first);
    }
    return std::max(timeline.instantIn(*stretch, time), first);
}

std::optional<ShownTick> tickBefore(Timeline& timeline, std::uint64_t instant) {
    std::optional<ShownTick> found;
    const TimelineKeyFrame* from =
        instant == 0 ? nullptr : timeline.keyFrames().atOrBefore(instant - 1);
    if (from != nullptr) {
        forEachTick(timeline, *from, [&](const ShownTick& tick) {
            const bool isBefore = tick.packet < instant;
            if (isBefore && tick.packet >= timeline.firstInstant()) {
                found = tick;
            }
            return isBefore;
        });
    }
    return found;
}

std::optional<ShownTick> tickAfter(Timeline& timeline, std::uint64_t instant) {
    std::optional<ShownTick> found;
    if (const TimelineKeyFrame* from = timeline.keyFrames().atOrBefore(instant)) {
        forEachTick(timeline, *from, [&](const ShownTick& tick) {
            if (tick.packet > instant) {
                found = tick;
            }
            return !found;
        });
    }
    return found;
}

} // namespace pallax
