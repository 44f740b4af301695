#include "sources/RecordingSource.h"

#include "host/JoinedRecording.h"

namespace pallax {

namespace {

using Known = Result<std::unique_ptr<Recording>, HostError>;

Known known(Recording::OpenResult recording) {
    if (!recording) {
        return HostError{recording.error().sentence};
    }
    if ((*recording)->technology() == nullptr) {
        return HostError{(*recording)->foreignLinkType().sentence};
    }
    return std::move(recording).value();
}

} // namespace

Known openKnownRecording(const Recording::Input& input) {
    return known(Recording::openInput(input));
}

Known openKnownRecording(const FileRecording& file) {
    return known(openParts(file.parts(), Recording::open));
}

Result<std::unique_ptr<PacketSource>, HostError> RecordingSource::open(const FileRecording& file) {
    auto recording = openKnownRecording(file);
    if (!recording) {
        return recording.error();
    }
    return std::unique_ptr<PacketSource>(
        std::make_unique<RecordingSource>(file, std::move(recording).value()));
}

std::string RecordingSource::technology() const {
    return std::string(_recording->technology()->identifier);
}

PacketSource::Next RecordingSource::next() {
    const auto packet = _recording->next();
    if (!packet) {
        return {State::End, std::nullopt};
    }
    return {State::Packet, Packet{packet->time, packet->data, packet->isOutOfRange}};
}

void RecordingSource::whenReady(std::function<void()> ready) {
    ready();
}

bool RecordingSource::restart() {
    auto again = openKnownRecording(_file);
    if (!again) {
        return false;
    }
    _recording = std::move(again).value();
    return true;
}

std::string RecordingSource::failure() const {
    return _recording->error() ? _recording->error()->sentence : std::string();
}

} // namespace pallax
