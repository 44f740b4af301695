#include "host/JoinedRecording.h"

#include "text/Format.h"

#include <algorithm>

namespace pallax {

namespace {

using Kind = RecordingError::Kind;

struct Part {
    std::string path;
    Time first = kLatestTime; ///< of its packets; parts without packets come last
};

RecordingError cannotJoin(const std::string& path, std::string_view reason) {
    return {Kind::CannotOpen, formatText("%@ cannot be joined: %@.", {path, reason})};
}

} // namespace

Recording::OpenResult JoinedRecording::open(const std::vector<std::string>& paths, Open open) {
    std::vector<Part> parts;
    std::optional<int> linkType;
    for (const std::string& path : paths) {
        const OpenResult opened = open(path);
        if (!opened) {
            return opened.error();
        }
        Recording& recording = **opened;
        if (recording.isStream()) {
            return cannotJoin(path, "it can be read only once");
        }
        if (linkType.value_or(recording.linkType()) != recording.linkType()) {
            return cannotJoin(path, formatText("its link type is %d, that of %@ is %d",
                                               {recording.linkType(), paths.front(), *linkType}));
        }
        linkType = recording.linkType();
        const auto packet = recording.next();
        parts.push_back({path, packet ? packet->time : kLatestTime});
    }
    std::stable_sort(parts.begin(), parts.end(),
                     [](const Part& one, const Part& other) { return one.first < other.first; });
    std::vector<std::string> ordered;
    ordered.reserve(parts.size());
    for (const Part& part : parts) {
        ordered.push_back(part.path);
    }
    std::unique_ptr<JoinedRecording> joined(
        new JoinedRecording(std::move(ordered), std::move(open)));
    if (!joined->openNext()) {
        return *joined->_failed;
    }
    joined->_name = nameOf(joined->_part->name(), parts.size() - 1);
    return std::unique_ptr<Recording>(std::move(joined));
}

std::string JoinedRecording::nameOf(const std::string& first, std::size_t further) {
    return further == 0 ? first : formatText("%@ and %zu more", {first, further});
}

void JoinedRecording::note(const RecordingError& error) {
    if (!_failed) {
        _failed = error;
    }
}

bool JoinedRecording::openNext() {
    while (_next < _paths.size()) {
        OpenResult opened = _open(_paths[_next++]);
        if (opened) {
            _part = std::move(opened).value();
            return true;
        }
        note(opened.error());
    }
    return false;
}

std::optional<RecordedPacket> JoinedRecording::next() {
    while (!_hasEnded) {
        if (auto packet = _part->next()) {
            return packet;
        }
        if (_part->error()) {
            note(*_part->error());
        }
        const std::uint64_t read = _part->position().value_or(0);
        _hasEnded = !openNext();
        _done += _hasEnded ? 0 : read;
    }
    _error = _failed;
    return std::nullopt;
}

std::optional<std::uint64_t> JoinedRecording::position() const {
    const auto position = _part->position();
    return position ? std::optional(_done + *position) : std::nullopt;
}

} // namespace pallax
