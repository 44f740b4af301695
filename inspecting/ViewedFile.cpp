#include "inspecting/ViewedFile.h"

#include "host/ServiceName.h"
#include "host/Snapshot.h"
#include "live/LiveSession.h"
#include "overview/DisplayValues.h"
#include "text/Format.h"

#include <algorithm>
#include <utility>

namespace pallax {

Result<std::unique_ptr<ViewedFile>, NotSeen>
ViewedFile::open(const std::string& path, const RecordedTechnology* technology,
                 const DecoderEnvironment& environment, const BoundedJournal::Limits& journal) {
    const auto recording = Recording::open(path);
    if (!recording) {
        const RecordingError& error = recording.error();
        return NotSeen{error.sentence, error.kind == RecordingError::Kind::Empty};
    }
    if ((*recording)->technology() == &kSnapshotTechnology) {
        return openSnapshot(**recording, environment);
    }
    const RecordedTimeline::Request request{{path}, technology, journal};
    auto recorded = (*recording)->isStream() // which can be opened only once
                        ? RecordedTimeline::openStream(**recording, request, environment)
                        : RecordedTimeline::open(request, environment);
    if (!recorded) {
        const RecordingError& error = recorded.error();
        return NotSeen{error.sentence, error.kind == RecordingError::Kind::Empty};
    }
    std::unique_ptr<ViewedFile> file(new ViewedFile);
    file->_name = (*recording)->name();
    file->_recorded = std::move(recorded).value();
    file->_timeline = &file->_recorded->timeline();
    file->_technology = technologyOfCommandName(file->_timeline->fields().technology());
    return file;
}

Result<std::unique_ptr<ViewedFile>, NotSeen> ViewedFile::of(LiveSession& session) {
    if (session.timeline() == nullptr) {
        return NotSeen{noPacketText(session.service())};
    }
    std::unique_ptr<ViewedFile> file(new ViewedFile);
    file->_name = liveModemName(session.service());
    file->_timeline = session.timeline();
    file->_technology = technologyOfCommandName(file->_timeline->fields().technology());
    file->_notes = session.notes();
    return file;
}

Result<std::unique_ptr<ViewedFile>, NotSeen>
ViewedFile::openSnapshot(Recording& recording, const DecoderEnvironment& environment) {
    std::unique_ptr<ViewedFile> file(new ViewedFile);
    file->_name = recording.name();
    while (const auto message = recording.next()) {
        const PropertyList display = displayIn(message->data);
        if (!file->_fields) {
            file->_technology = &technologyOfDisplay(display, environment.resources);
            file->_fields = std::make_unique<FieldTable>(*file->_technology, environment.resources);
        }
        auto& stretches = file->_stretches;
        if (stretches.empty() || message->time < stretches.back().end) {
            stretches.push_back({message->time, message->time});
        }
        stretches.back().end = message->time;
        Display& shown = file->_displays.emplace_back(Display{
            message->time, stretches.size() - 1, CurrentValues(*file->_fields, file->_entries)});
        giveDisplay(display, message->time, *file->_fields, shown.values);
    }
    if (recording.error()) {
        return NotSeen{recording.error()->sentence};
    }
    if (file->_displays.empty()) {
        return NotSeen{formatText("%@ is a snapshot without displays.", {file->_name}), true};
    }
    return file;
}

TimeSpan ViewedFile::span() const {
    TimeSpan span;
    span.stretches = _stretches;
    if (_timeline != nullptr) {
        for (const Stretch& stretch : _timeline->stretches()) {
            span.stretches.push_back({stretch.first, stretch.latest});
        }
    }
    span.begin = span.stretches.front().begin;
    span.end = span.begin;
    for (const TimeSpan::Stretch& stretch : span.stretches) {
        span.end = std::max(*span.end, stretch.end);
    }
    return span;
}

/// Nothing before the start.
std::optional<ViewedFile::Place>
ViewedFile::findBeforeEnd(std::chrono::nanoseconds distance,
                          const std::vector<TimeSpan::Stretch>& stretches) {
    for (std::size_t index = stretches.size(); index-- > 0;) {
        const TimeSpan::Stretch& stretch = stretches[index];
        const auto length = stretch.end - stretch.begin;
        if (distance <= length) {
            return Place{index, stretch.end - distance};
        }
        distance -= length;
    }
    return std::nullopt;
}

Result<ViewedFile::Place, NotSeen> ViewedFile::find(const TimeText& text,
                                                    const ZoneRule& zone) const {
    const TimeSpan span = this->span();
    if (const auto distance = text.beforeEnd()) {
        if (const auto place = findBeforeEnd(*distance, span.stretches)) {
            return *place;
        }
        return NotSeen{_name + ": " + text.errorOutside(span, zone).sentence};
    }
    const auto time = text.timeIn(span, zone);
    if (!time) {
        return NotSeen{_name + ": " + time.error().sentence};
    }
    for (std::size_t index = 0; index < span.stretches.size(); ++index) {
        if (span.stretches[index].begin <= *time && *time <= span.stretches[index].end) {
            return Place{index, *time};
        }
    }
    return NotSeen{_name + ": " + text.errorOutside(span, zone).sentence};
}

ViewedMoment ViewedFile::end() {
    if (_timeline == nullptr) {
        return {_displays.back().values, _displays.back().time};
    }
    const std::uint64_t packets = _timeline->packets();
    return {_timeline->valuesAt(packets), _timeline->stretches().back().latest, packets};
}

Result<ViewedMoment, NotSeen> ViewedFile::at(const std::optional<TimeText>& text,
                                             const ZoneRule& zone) {
    if (_timeline != nullptr && _timeline->packets() == 0) {
        return NotSeen{formatText("%@ holds no packets.", {_name}), true};
    }
    if (!text || text->isEnd()) {
        return end();
    }
    const auto place = find(*text, zone);
    if (!place) {
        return place.error();
    }
    if (_timeline != nullptr) {
        const std::uint64_t instant =
            _timeline->instantIn(_timeline->stretches()[place->stretch], place->time);
        return ViewedMoment{_timeline->valuesAt(instant), place->time, instant};
    }
    const Display* latest = nullptr;
    for (const Display& display : _displays) {
        const bool isBefore = display.stretch == place->stretch && display.time <= place->time;
        latest = isBefore ? &display : latest;
    }
    return ViewedMoment{latest->values, latest->time, 0, latest != &_displays.back()};
}

std::vector<std::string> ViewedFile::notes() const {
    return _recorded ? _recorded->notes() : _notes;
}

} // namespace pallax
