#include "recording/Recorder.h"

#include "host/Recording.h"
#include "link/WaitNotice.h"
#include "text/Format.h"

#include <algorithm>
#include <chrono>
#include <csignal>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::seconds kProgressInterval{1};

/// Unique, so that a viewer and other recorders can run at the same time.
std::string localPortName() {
    return formatText("%@.Recorder.%d", {ModemLink::kLocalPortName, ::getpid()});
}

/// Null when the answer is none of the known technologies.
const RecordedTechnology* technologyOf(const PropertyList& answer) {
    const auto identifier = answer.string();
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
      _modem(platform(), *this) {}

/// A viewer's with a shorter delay, because packets that come meanwhile are lost.
ModemLink::Platform Recorder::platform() {
    ModemLink::Platform viewers = _link.platform();
    viewers.retryDelay = kRetryDelay;
    return viewers;
}

std::optional<std::string> Recorder::run() {
    AsioMainQueue& queue = _link.queue();
    queue.onSignal({SIGINT, SIGTERM, SIGHUP}, [&queue](int /*signal*/) { queue.stop(); });
    _link.clock().onEnd([&queue] { queue.stop(); });
    queue.async([this] { _modem.startMonitor(); });
    const auto looks = queue.scheduleRepeating(kProgressInterval, [this] { tellProgress(); });
    const WaitNotice notice({queue, [this] { return _modem.isConnected(); },
                             [this] { return _link.obstacle(); }, _waits});
    queue.run();
    return _failure;
}

bool Recorder::wantsTechnology(const PropertyList& answer) {
    const RecordedTechnology* technology = technologyOf(answer);
    if (technology != nullptr && _wanted != nullptr && technology != _wanted) {
        fail(formatText("The modem's technology is %@ (%@), not %@.",
                        {technology->identifier, technology->commandName, _wanted->commandName}));
        return false;
    }
    if (technology != nullptr) { // the link starts with no other one
        _technology = technology;
    }
    return true;
}

void Recorder::setGenerator(std::unique_ptr<LogGenerator> generator) {
    _generator = std::move(generator);
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
        progressText(_files, packets - std::exchange(_packetsTold, packets), _modem.isConnected()));
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
