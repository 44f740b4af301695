#include "sources/RecordingSource.h"

namespace pallax {

Result<std::unique_ptr<Recording>, HostError> openKnownRecording(const Recording::Input& input) {
    auto recording = Recording::openInput(input);
    if (!recording) {
        return HostError{recording.error().sentence};
    }
    if ((*recording)->technology() == nullptr) {
        return HostError{(*recording)->foreignLinkType().sentence};
    }
    return std::move(recording).value();
}

Result<std::unique_ptr<PacketSource>, HostError> RecordingSource::open(const std::string& path) {
    auto recording = openKnownRecording({path});
    if (!recording) {
        return recording.error();
    }
    return std::unique_ptr<PacketSource>(
        std::make_unique<RecordingSource>(path, std::move(recording).value()));
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
    auto again = openKnownRecording({_path});
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
