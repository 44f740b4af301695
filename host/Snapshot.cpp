#include "host/Snapshot.h"

#include "plist/PropertyListCodec.h"
#include "text/Format.h"
#include "text/TimeText.h"

#include <utility>

namespace pallax {

namespace {

std::optional<std::string> textAt(const Dictionary& entries, std::string_view key) {
    const PropertyList* value = entries.find(key);
    return value != nullptr ? value->string() : std::nullopt;
}

/// "2023-11-14 22:13:20 +0000".
std::optional<Time> timeOf(std::string text) {
    const std::size_t beforeZone = text.rfind(' ');
    if (beforeZone != std::string::npos) {
        text.erase(beforeZone, 1);
    }
    const auto parsed = TimeText::parse(text);
    if (!parsed || parsed->needsEnd()) {
        return std::nullopt;
    }
    const auto time = parsed->timeIn({}, [](Time) { return std::chrono::seconds(0); });
    return time ? std::optional(*time) : std::nullopt;
}

void addEntry(Snapshot& snapshot, const Dictionary& entry) {
    const PropertyList* display = entry.find("Display");
    if (display != nullptr && display->dictionary() != nullptr) {
        snapshot.displays.push_back({textAt(entry, "Description").value_or(""),
                                     timeOf(textAt(entry, "Date").value_or("")), *display});
    }
    const PropertyList* log = entry.find("DLF");
    if (log != nullptr && log->data() != nullptr) {
        snapshot.dlf = log->data();
    }
}

/// Gives a message for each display.
class SnapshotRecording final : public Recording {
public:
    SnapshotRecording(std::string name, Snapshot snapshot, bool isStream)
        : _name(std::move(name)), _snapshot(std::move(snapshot)), _isStream(isStream) {}

    const Snapshot& snapshot() const { return _snapshot; }
    const std::string& name() const override { return _name; }
    bool isStream() const override { return _isStream; }
    std::string format() const override { return "snapshot"; }
    int linkType() const override { return kSnapshotTechnology.linkType; }
    const RecordedTechnology* technology() const override { return &kSnapshotTechnology; }
    RecordingError foreignLinkType() const override {
        return {RecordingError::Kind::UnknownLinkType, _name + " is a snapshot."};
    }
    std::optional<RecordedPacket> next() override;
    std::optional<std::uint64_t> position() const override { return 0; } // it is read as a whole
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    std::string _name;
    Snapshot _snapshot;
    bool _isStream;
    std::size_t _next = 0;
    Time _time = kEarliestTime;
    ByteBuffer _message;
    std::optional<RecordingError> _error;
};

std::optional<RecordedPacket> SnapshotRecording::next() {
    if (_next == _snapshot.displays.size()) {
        return std::nullopt;
    }
    const Snapshot::Display& display = _snapshot.displays[_next++];
    const auto message = serializeBinary(Dictionary{{kSnapshotSaved, _snapshot.saved},
                                                    {kSnapshotDescription, _snapshot.description},
                                                    {kSnapshotTitle, display.description},
                                                    {kSnapshotDisplay, display.content}});
    if (!message) {
        _error = RecordingError{RecordingError::Kind::Unreadable,
                                _name + " cannot be read further: " + message.error().reason + "."};
        _next = _snapshot.displays.size();
        return std::nullopt;
    }
    _message = *message;
    _time = display.time.value_or(_time);
    return RecordedPacket{_time, _message, false};
}

} // namespace

std::optional<Snapshot> snapshotOf(const PropertyList& object) {
    const DictionaryRef root = object.dictionary();
    const auto saved = root ? textAt(*root, "Timestamp") : std::nullopt;
    const PropertyList* data = saved ? root->find("Data") : nullptr;
    const ArrayRef entries = data != nullptr ? data->array() : nullptr;
    if (!entries) {
        return std::nullopt;
    }
    Snapshot snapshot{*saved, textAt(*root, "Description").value_or(""), {}, nullptr};
    for (const PropertyList& entry : *entries) {
        const DictionaryRef fields = entry.dictionary();
        if (!fields) {
            return std::nullopt;
        }
        addEntry(snapshot, *fields);
    }
    return snapshot;
}

std::optional<Snapshot> snapshotIn(Bytes content) {
    if (formOf(content) == PropertyListForm::Text) {
        return std::nullopt;
    }
    const auto object = parsePropertyList(content);
    return object ? snapshotOf(*object) : std::nullopt;
}

std::unique_ptr<Recording> recordingOf(Snapshot snapshot, const std::string& name, bool isStream) {
    return std::make_unique<SnapshotRecording>(name, std::move(snapshot), isStream);
}

const Snapshot* snapshotOf(const Recording& recording) {
    const auto* snapshot = dynamic_cast<const SnapshotRecording*>(&recording);
    return snapshot != nullptr ? &snapshot->snapshot() : nullptr;
}

PropertyList displayIn(Bytes message) {
    const auto object = parsePropertyList(message);
    const DictionaryRef keys = object ? object->dictionary() : nullptr;
    const PropertyList* display = keys ? keys->find(kSnapshotDisplay) : nullptr;
    return display != nullptr ? *display : PropertyList();
}

RecordingError noTimeOfSnapshot(const std::string& path) {
    return {RecordingError::Kind::NoCapture,
            formatText("%@ is a snapshot, which holds a few displays and no packets.", {path})};
}

} // namespace pallax
