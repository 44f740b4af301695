#include "inspecting/ViewedFile.h"

#include "host/RecordingFile.h"
#include "host/Snapshot.h"
#include "live/LiveSession.h"
#include "overview/DisplayValues.h"
#include "plist/PropertyListCodec.h"
#include "text/Format.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kTooEarly = "%@: every packet is later than the time that is asked for.";

/// The display in a message of a snapshot; null if there is none.
PropertyList displayIn(Bytes message) {
    const auto object = parsePropertyList(message);
    const DictionaryRef keys = object ? object->dictionary() : nullptr;
    const PropertyList* display = keys ? keys->find(kSnapshotDisplay) : nullptr;
    return display != nullptr ? *display : PropertyList();
}

} // namespace

Result<std::unique_ptr<ViewedFile>, NotSeen>
ViewedFile::open(const std::string& path, const RecordedTechnology* technology,
                 const DecoderEnvironment& environment, const BoundedJournal::Limits& journal) {
    if (!RecordingFile::isStream(path)) { // a stream can be opened only once
        const auto recording = Recording::open(path);
        if (!recording) {
            const RecordingError& error = recording.error();
            return NotSeen{error.sentence, error.kind == RecordingError::Kind::Empty};
        }
        if ((*recording)->technology() == &kSnapshotTechnology) {
            return openSnapshot(**recording, environment);
        }
    }
    auto recorded = RecordedTimeline::open({{path}, technology, journal}, environment);
    if (!recorded) {
        const RecordingError& error = recorded.error();
        return NotSeen{error.sentence, error.kind == RecordingError::Kind::Empty};
    }
    std::unique_ptr<ViewedFile> file(new ViewedFile);
    file->_name = path == "-" ? "standard input" : path;
    file->_recorded = std::move(recorded).value();
    file->_timeline = &file->_recorded->timeline();
    file->_technology = technologyOfCommandName(file->_timeline->fields().technology());
    return file;
}

Result<std::unique_ptr<ViewedFile>, NotSeen> ViewedFile::of(LiveSession& session) {
    if (session.timeline() == nullptr) {
        return NotSeen{std::string(LiveSession::kNoPacket)};
    }
    std::unique_ptr<ViewedFile> file(new ViewedFile);
    file->_name = "live modem";
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
        Display& shown = file->_displays.emplace_back(
            Display{message->time, CurrentValues(*file->_fields, file->_entries)});
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
    if (_timeline == nullptr) {
        return {_displays.front().time, _displays.back().time};
    }
    const auto& stretches = _timeline->stretches();
    TimeSpan span{stretches.front().first, stretches.front().latest};
    for (const Stretch& stretch : stretches) {
        span.end = std::max(*span.end, stretch.latest);
    }
    return span;
}

Result<Moment, NotSeen> ViewedFile::at(const std::optional<TimeText>& text, const ZoneRule& zone) {
    if (_timeline != nullptr && _timeline->packets() == 0) {
        return NotSeen{formatText("%@ holds no packets.", {_name}), true};
    }
    std::optional<Time> time;
    if (text) {
        const auto found = text->timeIn(span(), zone);
        if (!found) {
            return NotSeen{_name + ": " + found.error().sentence};
        }
        time = *found;
    }
    if (_timeline == nullptr) {
        const Display* latest = nullptr;
        for (const Display& display : _displays) {
            latest = !time || display.time <= *time ? &display : latest;
        }
        return latest != nullptr
                   ? Result<Moment, NotSeen>(Moment{latest->values, latest->time})
                   : NotSeen{formatText(
                         "%@: every display is later than the time that is asked for.", {_name})};
    }
    Timeline& timeline = *_timeline;
    if (!time) {
        return Moment{timeline.valuesAt(timeline.packets()), timeline.stretches().back().latest,
                      timeline.packets()};
    }
    const auto instant = timeline.instantAt(*time);
    if (!instant) {
        return NotSeen{formatText(kTooEarly, {_name})};
    }
    return Moment{timeline.valuesAt(*instant), std::min(*time, timeline.stretchOf(*time)->latest),
                  *instant};
}

std::vector<std::string> ViewedFile::notes() const {
    return _recorded ? _recorded->notes() : _notes;
}

} // namespace pallax
