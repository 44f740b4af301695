#include "live/LiveRecording.h"

#include "host/ServiceName.h"
#include "live/LiveSession.h"
#include "platform/RecordedTechnology.h"
#include "text/Format.h"

#include <utility>

namespace pallax {

Recording::OpenResult LiveRecording::open(const Setup& setup) {
    using Kind = RecordingError::Kind;
    auto directory = SocketDirectory::open(setup.service);
    if (!directory) {
        return RecordingError{Kind::CannotOpen, directory.error().sentence};
    }
    std::unique_ptr<LiveRecording> made(new LiveRecording(std::move(directory).value(), setup));
    made->receive();
    if (made->_error) {
        return *made->_error;
    }
    if (!made->_stamp) {
        return RecordingError{Kind::Empty, noPacketText(setup.service)};
    }
    return std::unique_ptr<Recording>(std::move(made));
}

LiveRecording::LiveRecording(SocketDirectory directory, const Setup& setup)
    : _name(liveModemName(setup.service)),
      _receiver({std::move(directory), "Reader", setup.wanted,
                 [this](const RecordedTechnology& technology, Time stamp, Bytes packet) {
                     take(technology, stamp, packet);
                 },
                 setup.waits, setup.duration}) {}

void LiveRecording::take(const RecordedTechnology& technology, Time stamp, Bytes packet) {
    if (_technology != nullptr && _technology != &technology) {
        return _receiver.fail(
            formatText("The modem's technology is now %@ (%@), not %@.",
                       {technology.identifier, technology.commandName, _technology->commandName}));
    }
    _technology = &technology;
    _stamp = stamp;
    _packet.assign(packet.begin(), packet.end());
    _receiver.pause();
}

void LiveRecording::receive() {
    if (const auto failure = _receiver.run()) {
        _error = RecordingError{RecordingError::Kind::Unreadable, *failure};
    }
}

std::optional<RecordedPacket> LiveRecording::next() {
    if (!_stamp) {
        receive();
    }
    const auto stamp = std::exchange(_stamp, std::nullopt);
    return stamp ? std::optional(RecordedPacket{*stamp, _packet}) : std::nullopt;
}

} // namespace pallax
