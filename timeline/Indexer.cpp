#include "timeline/Indexer.h"

#include "platform/RecordedTechnology.h"
#include "platform/SystemLog.h"

#include <algorithm>
#include <exception>
#include <utility>

namespace pallax {

namespace {

constexpr std::size_t kMostStretches = 65536;

} // namespace

Timeline::Indexer::Indexer(Timeline& timeline, std::chrono::nanoseconds pingPong)
    : _timeline(timeline), _finder(timeline._source.technology.commandName, timeline._fields,
                                   timeline._entries, pingPong),
      _values(timeline._fields, timeline._entries), _replay(timeline._source) {
    addKeyFrame(); // of the state before the first packet
    _values.setListener(this);
}

bool Timeline::Indexer::run(const MayContinue& mayContinue) {
    constexpr std::uint64_t kAskedEvery = 16; // packets
    const MutedSystemLog muted;
    if (!_reader) {
        _reader = _timeline._journal.reader(_timeline._packets + 1);
    }
    for (std::uint64_t count = 1; !_timeline._hasEnded; ++count) {
        if (mayContinue && count % kAskedEvery == 0 && !mayContinue()) {
            return false;
        }
        const auto packet = _reader->next();
        if (!packet) {
            break;
        }
        take(*packet);
    }
    _timeline._keyFrames.dropBefore(_timeline._journal.first());
    return true;
}

void Timeline::Indexer::take(const JournalPacket& packet) {
    const bool isAfterLost = packet.number != _timeline._packets + 1;
    if (isAfterLost || _timeline._keyFrames.isDue(_packetsSince, _bytesSince)) {
        _timeline._packets = packet.number - 1;
        addKeyFrame();
    }
    noteStamp(packet);
    ++_packetsSince;
    _bytesSince += packet.data.size();
    _timeline._series.beginPacket(packet.number, packet.time);
    try {
        _replay.update(packet, &_values);
    } catch (const std::exception& error) {
        return endAt(packet, error.what());
    }
    _timeline._packets = packet.number;
    _finder.endPacket(packet.number, packet.time, _values, _found);
    for (Event& event : _found) {
        addEvent(std::move(event));
    }
    _found.clear();
}

void Timeline::Indexer::noteStamp(const JournalPacket& packet) {
    const auto tick = _grid.passedBefore(packet.time);
    if (tick) {
        if (_ticks.size() == 2) {
            _ticks.erase(_ticks.begin());
        }
        _ticks.push_back({*tick, packet.number - 1});
    }
    const auto& step = _grid.step();
    if (step && step->kind != StampRemark::Kind::OutOfRange) {
        addEvent(EventFinder::eventOf(*step, packet.number, packet.time));
        _finder.noteStep();
    }
    std::vector<Stretch>& stretches = _timeline._stretches;
    const bool isBack = step && step->kind == StampRemark::Kind::StepBack;
    if (stretches.empty() || (isBack && stretches.size() < kMostStretches)) {
        stretches.push_back({packet.number, packet.time, packet.time});
    }
    stretches.back().latest = std::max(stretches.back().latest, packet.time);
}

void Timeline::Indexer::addKeyFrame() {
    const std::vector<Stretch>& stretches = _timeline._stretches;
    _values.setListener(nullptr); // not kept in the copy
    _timeline._keyFrames.add({_timeline._packets, _replay.keyFrame(), _values, _grid, _ticks,
                              stretches.empty() ? Time::min() : stretches.back().latest});
    _values.setListener(this);
    _packetsSince = 0;
    _bytesSince = 0;
}

void Timeline::Indexer::addEvent(Event event) {
    std::vector<Event>& events = _timeline._events;
    if (events.size() >= _timeline._mostEvents) { // a quarter at once, which is rarely needed
        const std::size_t dropped = std::max<std::size_t>(events.size() / 4, 1);
        events.erase(events.begin(), events.begin() + static_cast<std::ptrdiff_t>(dropped));
        _timeline._eventsDropped += dropped;
    }
    events.push_back(std::move(event));
}

void Timeline::Indexer::endAt(const JournalPacket& packet, std::string_view reason) {
    _timeline._hasEnded = true;
    addEvent({EventKind::FatalRecord,
              packet.time,
              packet.number,
              "fatal record: " + std::string(reason),
              {}});
}

} // namespace pallax
