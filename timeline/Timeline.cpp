#include "timeline/Timeline.h"

#include "text/Format.h"
#include "timeline/Indexer.h"

#include <algorithm>
#include <limits>
#include <stdexcept>
#include <utility>

namespace pallax {

Timeline::Timeline(PacketJournal& journal, const DecodingSource& source, const Limits& limits)
    : _journal(journal), _resources(source.resources), _source{source.technology, _resources,
                                                               source.bundle, source.technologies},
      _fields(source.technology, _resources), _keyFrames(limits.keyFrames), _series(limits.series),
      _mostEvents(limits.events), _indexer(std::make_unique<Indexer>(*this, limits.pingPong)) {}

Timeline::~Timeline() = default;

bool Timeline::index(const MayContinue& mayContinue) {
    return _indexer->run(mayContinue);
}

const CurrentValues& Timeline::latestValues() const {
    return _indexer->values();
}

std::uint64_t Timeline::firstInstant() const {
    const auto& keyFrames = _keyFrames.all();
    return keyFrames.empty() ? _packets : keyFrames.front().packet;
}

const Stretch* Timeline::stretchOf(Time time) const {
    const Stretch* nearest = nullptr;
    for (const Stretch& stretch : _stretches) {
        if (stretch.first <= time) {
            if (time <= stretch.latest) {
                return &stretch;
            }
            const bool isNearer = nearest == nullptr || stretch.latest > nearest->latest;
            nearest = isNearer ? &stretch : nearest;
        }
    }
    return nearest;
}

const Stretch* Timeline::stretchOfInstant(std::uint64_t instant) const {
    const auto past = std::upper_bound(
        _stretches.begin(), _stretches.end(), instant,
        [](std::uint64_t at, const Stretch& stretch) { return at < stretch.firstPacket; });
    if (_stretches.empty()) {
        return nullptr;
    }
    return past == _stretches.begin() ? &_stretches.front() : &*(past - 1);
}

std::optional<std::uint64_t> Timeline::instantAt(Time time) const {
    const Stretch* stretch = stretchOf(time);
    return stretch != nullptr ? std::optional(instantIn(*stretch, time)) : std::nullopt;
}

std::uint64_t Timeline::instantIn(const Stretch& stretch, Time time) const {
    std::uint64_t instant = stretch.firstPacket;
    const std::uint64_t end =
        &stretch == &_stretches.back() ? _packets : (&stretch + 1)->firstPacket - 1;
    for (const TimelineKeyFrame& frame : _keyFrames.all()) {
        if (frame.packet > end) {
            break;
        }
        instant = frame.latest <= time ? std::max(instant, frame.packet) : instant;
    }
    const auto reader = _journal.reader(instant + 1);
    while (instant < end) {
        const auto packet = reader->next();
        if (!packet || packet->number > end || packet->time > time) {
            break;
        }
        instant = packet->number;
    }
    return instant;
}

void Timeline::add(Event event) {
    const auto isBefore = [](const Event& a, const Event& b) { return a.packet < b.packet; };
    const auto [first, last] = std::equal_range(_events.begin(), _events.end(), event, isBefore);
    const bool isThere = std::any_of(first, last, [&event](const Event& each) {
        return each.kind == event.kind && each.words == event.words;
    });
    const bool isDropped = _eventsDropped != 0 && last == _events.begin();
    if (!isThere && !isDropped) {
        _events.insert(last, std::move(event));
    }
}

std::vector<std::string> Timeline::notes() const {
    std::vector<std::string> notes;
    if (_fields.isFull()) {
        notes.emplace_back(FieldTable::kFullNote);
    }
    if (_entries.isFull() || _series.isFull()) {
        notes.emplace_back("There are too many list entries to keep a series of each.");
    }
    if (_eventsDropped != 0) {
        notes.push_back(std::to_string(_eventsDropped) + " earlier events are left out.");
    }
    if (auto trouble = _journal.trouble()) {
        notes.push_back(std::move(*trouble));
    }
    if (_hasEnded) {
        const Event& fatal = *std::find_if(_events.rbegin(), _events.rend(), [](const Event& each) {
            return each.kind == EventKind::FatalRecord;
        });
        notes.push_back(formatText("Packet %llu cannot be read: %@", {fatal.packet, fatal.words}));
    }
    return notes;
}

CurrentValues Timeline::valuesAt(std::uint64_t instant) {
    const TimelineKeyFrame* from = _keyFrames.atOrBefore(instant);
    if (from == nullptr) {
        throw std::out_of_range("the journal no longer has this instant");
    }
    CurrentValues values = from->values;
    Replay replay(_source);
    replay.resume(from->decoder, from->packet);
    advance(replay, instant, &values);
    return values;
}

PropertyList Timeline::displayAt(std::uint64_t instant) {
    return replayAt(instant)->displayAt({});
}

std::unique_ptr<Replay> Timeline::replayAt(std::uint64_t instant) {
    const TimelineKeyFrame* from = _keyFrames.atOrBefore(instant);
    if (from == nullptr) {
        throw std::out_of_range("the journal no longer has this instant");
    }
    auto replay = replayFrom(from->decoder, from->packet);
    advance(*replay, instant);
    return replay;
}

std::unique_ptr<Replay> Timeline::replayFrom(const KeyFrame& from, std::uint64_t packet) const {
    auto replay = std::make_unique<Replay>(_source);
    replay->resume(from, packet);
    return replay;
}

namespace {

/// Takes the samples of packets that are only read for what the decoder keeps of them.
class NoSamples final : public SampleSink {
public:
    void sample(const Sample& /*sample*/) override {}
    void keyRemoved(std::string_view /*key*/) override {}
    void beginList(const SampleList& /*list*/) override {}
    void endList() override {}
    void beginEntry(std::size_t /*index*/, std::int64_t /*name*/) override {}
    void endEntry() override {}
};

} // namespace

void Timeline::advance(Replay& replay, std::uint64_t instant, SampleSink* sink) {
    if (replay.packet() >= instant) {
        return;
    }
    // The paths of an object stream are numbered when their samples are given.
    NoSamples numbering;
    SampleSink* const to = sink == nullptr && _fields.isObjectStream() ? &numbering : sink;
    const auto reader = _journal.reader(replay.packet() + 1);
    while (replay.packet() < instant) {
        const auto packet = reader->next();
        if (!packet || packet->number > instant) {
            break;
        }
        replay.update(*packet, to);
    }
}

bool Timeline::read(std::uint64_t from, std::uint64_t to, SampleSink& sink,
                    const MayContinue& mayContinue) {
    from = std::max(from, firstInstant() + 1);
    to = std::min(to, _packets);
    if (from > to) {
        return true;
    }
    const auto replay = replayAt(from - 1);
    const auto reader = _journal.reader(from);
    while (replay->packet() < to) {
        if (mayContinue && !mayContinue()) {
            return false;
        }
        const auto packet = reader->next();
        if (!packet || packet->number > to) {
            break;
        }
        replay->update(*packet, &sink);
    }
    return true;
}

} // namespace pallax
