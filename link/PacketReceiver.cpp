#include "link/PacketReceiver.h"

#include "platform/RecordedTechnology.h"
#include "text/Format.h"

#include <algorithm>
#include <csignal>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

/// Unique, so that a viewer and other receivers can run at the same time.
std::string receivingPortName(std::string_view program) {
    return formatText("%@.%@.%d", {ModemLink::kLocalPortName, program, ::getpid()});
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

PacketReceiver::PacketReceiver(Setup setup)
    : _setup(std::move(setup)), _link(_queue, std::move(_setup.directory), OnFatalRecord::Skip,
                                      _setup.child, _notices, receivingPortName(_setup.program)),
      _modem(platform(), *this) {}

ModemLink::Platform PacketReceiver::platform() {
    ModemLink::Platform viewers = _link.platform();
    viewers.retryDelay = kRetryDelay;
    return viewers;
}

std::optional<std::string> PacketReceiver::run() {
    if (!_notice) {
        start();
    }
    if (!_isOver) {
        _link.queue().run();
    }
    return _failure;
}

void PacketReceiver::start() {
    AsioMainQueue& queue = _link.queue();
    queue.onSignal({SIGINT, SIGTERM, SIGHUP}, [this](int /*signal*/) { stop(); });
    _link.clock().onEnd(_setup.ended ? _setup.ended : [this] { stop(); });
    queue.async([this] { _modem.startMonitor(); });
    _notice.emplace(WaitNotice::Setup{queue, [this] { return _modem.isConnected(); },
                                      [this] { return _link.obstacle(); }, _setup.waits});
    if (_link.hasChild()) {
        _looks = queue.scheduleRepeating(BrowseLink::kLookInterval, [this] {
            if (_link.childHasEnded()) {
                fail(_setup.lostChild);
            }
        });
    }
    if (_setup.duration) {
        _end = _link.clock().scheduleRepeating(*_setup.duration, [this] { stop(); });
    }
}

bool PacketReceiver::wantsTechnology(const PropertyList& answer) {
    const RecordedTechnology* technology = technologyOf(answer);
    const RecordedTechnology* wanted = _setup.wanted;
    if (technology != nullptr && wanted != nullptr && technology != wanted) {
        fail(formatText("The modem's technology is %@ (%@), not %@.",
                        {technology->identifier, technology->commandName, wanted->commandName}));
        return false;
    }
    if (technology != nullptr) { // the link starts with no other one
        _technology = technology;
    }
    return true;
}

void PacketReceiver::setGenerator(std::unique_ptr<LogGenerator> generator) {
    _generator = std::move(generator);
}

void PacketReceiver::packetArrived(Bytes packet) {
    if (_technology != nullptr && !_isOver) {
        _setup.packet(*_technology, _link.clock().stamp(), packet);
    }
}

void PacketReceiver::fail(std::string sentence) {
    if (!_failure) {
        _failure = std::move(sentence);
    }
    stop();
}

void PacketReceiver::stop() {
    _isOver = true;
    _link.queue().stop();
}

} // namespace pallax
