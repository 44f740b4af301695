#include "recording/Recorder.h"

#include "host/Recording.h"
#include "link/WaitNotice.h"
#include "plist/PropertyListCodec.h"
#include "telephony/ControlMessages.h"
#include "text/Format.h"

#include <algorithm>
#include <chrono>
#include <csignal>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::seconds kProgressInterval{1};

/// A name of its own, so that a viewer and other recorders may run at the same time.
std::string localPortName() {
    return formatText("%@.Recorder.%d", {PallaxModel::kLocalPortName, ::getpid()});
}

/// Null when the reply names none of the known technologies.
const RecordedTechnology* technologyIn(Bytes reply) {
    const auto message = decodeMessage(reply);
    const auto identifier = message ? stringIn(*message, "GetTechnology") : std::nullopt;
    const auto all = recordedTechnologies();
    const auto found = std::find_if(all.begin(), all.end(), [&](const RecordedTechnology& each) {
        return identifier == each.identifier;
    });
    return found != all.end() ? &*found : nullptr;
}

} // namespace

Recorder::Recorder(SocketDirectory directory, const RecordedTechnology* wanted,
                   RecordingFiles& files, Progress progress, Progress waits)
    : _wanted(wanted), _files(files), _progress(std::move(progress)), _waits(std::move(waits)),
      _link(std::move(directory), OnFatalRecord::Skip, nullptr, _notices, localPortName()),
      _browsing(_link.modelPlatform(*this)), _ports(_browsing.ports, *this), _model(platform()) {}

/// A viewer's, but for the ports and the delay: what is not recorded meanwhile is lost.
PallaxModel::Platform Recorder::platform() {
    return {_ports,
            _browsing.telephony,
            _browsing.queue,
            _browsing.timers,
            _browsing.generators,
            _browsing.technologies,
            _browsing.observer,
            _browsing.localPortName,
            kRetryDelay};
}

std::optional<std::string> Recorder::run() {
    AsioMainQueue& queue = _link.queue();
    queue.onSignal({SIGINT, SIGTERM, SIGHUP}, [&queue](int /*signal*/) { queue.stop(); });
    _link.clock().onEnd([&queue] { queue.stop(); });
    queue.async([this] { _model.startMonitor(); });
    const auto looks = queue.scheduleRepeating(kProgressInterval, [this] { tellProgress(); });
    const WaitNotice notice({queue, [this] { return _model.isConnected(); },
                             [this] { return _link.obstacle(); }, _waits});
    queue.run();
    return _failure;
}

bool Recorder::replied(Bytes reply) {
    const RecordedTechnology* technology = technologyIn(reply);
    if (technology != nullptr && _wanted != nullptr && technology != _wanted) {
        fail(formatText("The modem's technology is %@ (%@), not %@.",
                        {technology->identifier, technology->commandName, _wanted->commandName}));
        return false;
    }
    if (technology != nullptr) { // otherwise, as for the model, the earlier one stays
        _technology = technology;
    }
    return true;
}

void Recorder::packetArrived(Bytes packet) {
    if (_technology == nullptr || _isOver) {
        return;
    }
    const auto error = _files.add(*_technology, _link.clock().stamp(), packet);
    if (error && error->readerHasGone) {
        stop();
    } else if (error) {
        fail(failureText(*error, _files));
    }
}

void Recorder::fail(std::string sentence) {
    if (!_failure) {
        _failure = std::move(sentence);
    }
    stop();
}

void Recorder::stop() {
    _isOver = true;
    _link.queue().stop();
}

void Recorder::tellProgress() {
    const std::uint64_t packets = _files.packets();
    _progress(
        progressText(_files, packets - std::exchange(_packetsTold, packets), _model.isConnected()));
}

std::string Recorder::failureText(const HostError& error, const RecordingFiles& files) {
    return formatText("%@ %llu packets are recorded.", {error.sentence, files.packets()});
}

std::string Recorder::progressText(const RecordingFiles& files, std::uint64_t packetsPerSecond,
                                   bool isConnected) {
    const std::string sum =
        formatText("%llu packets, %llu bytes", {files.packets(), files.bytes()});
    return isConnected ? formatText("%@, %llu packets/s", {sum, packetsPerSecond})
                       : formatText("%@, waiting for the modem", {sum});
}

} // namespace pallax
