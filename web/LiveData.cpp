#include "web/LiveData.h"

#include "decoding/DisplayJson.h"
#include "fields/Reference.h"
#include "masking/MaskedPlaces.h"
#include "platform/RecordedTechnology.h"
#include "report/ReportWalk.h"
#include "timeline/Timeline.h"
#include "web/SeriesJson.h"

#include <algorithm>
#include <chrono>
#include <tuple>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::seconds kGap{60}; // as an event "gap"

} // namespace

LiveData::LiveData(Setup setup) : _setup(std::move(setup)) {
    begin(nullptr);
}

LiveData::~LiveData() = default;

void LiveData::begin(Timeline* timeline) {
    _follower.reset();
    _timeline = timeline;
    _ticks.clear();
    _stretches.clear();
    _stateTick = 0;
    _isUpToDate = false;
    if (timeline != nullptr) {
        const auto* technology = technologyOfCommandName(timeline->fields().technology());
        _setup.head.technology = gatherReference(*technology, _setup.resources).title;
        _follower = std::make_unique<TickFollower>(*timeline);
        _isLeftOut =
            _setup.head.hasIdentities ? IsLeftOut() : maskedPlaces(*technology, _setup.resources);
    }
    _report = std::make_unique<ReportBuilder>(_setup.names, _setup.profile, _isLeftOut);
}

bool LiveData::follow(const std::function<bool()>& mayContinue) {
    return _follower == nullptr ||
           _follower->follow([this](const auto& tick, const auto& values) { take(tick, values); },
                             mayContinue);
}

void LiveData::settle() {
    if (_follower != nullptr) {
        _follower->settle([this](const auto& tick, const auto& values) { take(tick, values); });
    }
}

/// The builder keeps no displays: the timeline makes that of any tick again.
void LiveData::take(const ShownTick& tick, const CurrentValues& values) {
    const Time time = tick.tick.time;
    const bool isAfterStep = !_ticks.empty() && (time < _ticks.back().tick.time ||
                                                 time - _ticks.back().tick.time > kGap);
    if (_ticks.empty() || time < _ticks.back().tick.time) {
        _stretches.push_back(_ticks.size());
    }
    _report->take(
        {time, values, PropertyList(), isAfterStep, firstPacketAround(*_timeline, tick.packet)});
    _ticks.push_back(tick);
    _isUpToDate = false;
}

const PropertyList& LiveData::figures() {
    if (!_isUpToDate) {
        _isUpToDate = true;
        _figures = _timeline != nullptr ? gatherFigures() : Dictionary();
    }
    return _figures;
}

Dictionary LiveData::gatherFigures() const {
    ReportHead head = _setup.head;
    head.packets = _timeline->packets();
    for (std::string& note : _timeline->notes()) {
        head.notes.push_back(std::move(note));
    }
    return figuresOf(head, *_report, _timeline->events(), _timeline->fields());
}

/// The places of a stretch's first tick, and of that after its last one.
std::pair<std::size_t, std::size_t> LiveData::ticksOf(std::size_t stretch) const {
    const auto begin = [this](std::size_t place) {
        return place < _stretches.size() ? _stretches[place] : _ticks.size();
    };
    return {begin(stretch), begin(stretch + 1)};
}

std::string LiveData::series(const std::vector<std::uint32_t>& ids, SeriesRange range,
                             std::size_t stretch) const {
    std::tie(range.first, range.end) = ticksOf(stretch);
    static const HeldSeries kNone;
    std::vector<const HeldSeries*> series;
    for (const std::uint32_t id : ids) {
        const HeldSeries* found = &kNone;
        for (const ReportMeasure& measure : _report->measures()) {
            found = measure.id == id ? &measure.series : found;
        }
        for (const ReportNeighbour& neighbour : _report->neighbours()) {
            found = neighbour.id == id ? &neighbour.series : found;
        }
        series.push_back(found);
    }
    return seriesJson(_report->ticks(), series, range);
}

const ShownTick* LiveData::tickAt(Time at, std::size_t stretch) const {
    const ShownTick* found = nullptr;
    const auto [first, end] = ticksOf(stretch);
    const std::size_t skipped = _ticks.size() - end;
    const auto isKept = [this](const ShownTick& tick) {
        return _timeline->keyFrames().atOrBefore(tick.packet) != nullptr;
    };
    const auto last = _ticks.rend() - static_cast<std::ptrdiff_t>(first);
    for (auto tick = _ticks.rbegin() + static_cast<std::ptrdiff_t>(skipped);
         tick != last && isKept(*tick); ++tick) {
        found = &*tick;
        if (tick->tick.time <= at) {
            break;
        }
    }
    return found;
}

std::optional<std::string> LiveData::state(Time at, std::size_t stretch) {
    const ShownTick* tick = tickAt(at, stretch);
    if (tick == nullptr) {
        return std::nullopt;
    }
    const ShownTick& shown = *tick;
    if (_stateTick != shown.tick.number) {
        _state = "{\"time\":";
        appendJson(_state, PropertyList::real(pageSeconds(shown.tick.time)));
        _state += ",\"tick\":" + std::to_string(shown.tick.number) + ",\"display\":";
        const PropertyList display = _timeline->displayAt(shown.packet);
        appendJson(_state, _isLeftOut ? withLeftOut(display, _isLeftOut) : display);
        _state += '}';
        _stateTick = shown.tick.number;
    }
    return _state;
}

std::optional<Status> LiveData::status() const {
    if (_timeline == nullptr || _timeline->packets() == 0) {
        return std::nullopt;
    }
    const CurrentValues& values = _timeline->latestValues();
    return statusOf(values, values.time(), _setup.names, _setup.profile);
}

} // namespace pallax
