#include "timeline/Instants.h"

#include "LogGenerator/SectionAges.h"

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

FrameRef frameOf(Replay& replay, const ShownTick& tick, const FrameRef& before) {
    const auto paths = std::make_shared<PathDictionary>();
    NodeRef root = PallaxModelNode::makeTreeFromObject(replay.displayAt(tick.tick.time), *paths);
    const SectionAges ages = replay.ages();
    return std::make_shared<Frame>(Frame::Picture{std::move(root), paths, tick.tick.time},
                                   before.get(), &ages);
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

std::optional<TickFrame> frameAt(Timeline& timeline, Time time) {
    const std::vector<ShownTick> ticks = ticksAt(timeline, time);
    if (ticks.empty() || ticks.front().packet < timeline.firstInstant()) {
        return std::nullopt;
    }
    std::unique_ptr<Replay> replay = timeline.replayAt(ticks.front().packet);
    TickFrame made{frameOf(*replay, ticks.front(), nullptr), nullptr, ticks.back().tick,
                   ticks.back().packet};
    if (ticks.size() == 2) {
        const TimelineKeyFrame* nearest = timeline.keyFrames().atOrBefore(ticks.back().packet);
        if (nearest != nullptr && nearest->packet > replay->packet()) {
            replay = timeline.replayAt(ticks.back().packet);
        } else {
            timeline.advance(*replay, ticks.back().packet);
        }
        made.before = std::exchange(made.frame, nullptr);
        made.frame = frameOf(*replay, ticks.back(), made.before);
    }
    return made;
}

} // namespace pallax
