#include "link/BrowseLink.h"

#include "decoding/SnapshotDisplay.h"
#include "telephony/ChildService.h"
#include "text/Format.h"

#include <sys/wait.h>
#include <unistd.h>
#include <utility>

namespace pallax {

BrowseLink::BrowseLink(AsioMainQueue& queue, SocketDirectory directory, OnFatalRecord onFatalRecord,
                       ChildService* child, StandardOutput& notices, std::string_view localPortName)
    : _child(child), _notices(notices),
      _localPortName(child != nullptr ? child->privateName(localPortName)
                                      : std::string(localPortName)),
      _queue(queue), _clock(_wallClock, _queue),
      _controlPortName(child != nullptr ? child->controlPortName()
                                        : std::string(kTelephonyControlPort)),
      _socketPorts(_queue, std::move(directory), &_clock),
      _telephony(_socketPorts, _controlPortName),
      _linkPorts({_socketPorts, _telephony,
                  formatText("%@.Viewer.%d", {ModemLink::kLocalPortName, ::getpid()}),
                  [this] { return _socketPorts.lastError(); },
                  [this] { return _socketPorts.isTaken(_controlPortName); },
                  _socketPorts.directory().service()}),
      _ports(
          _linkPorts, onFatalRecord, [this] { return _clock.packetNumber(); },
          _socketPorts.directory().service()),
      _resources(DirectoryResources::programFolder()) {}

ModemLink::Platform BrowseLink::platform() {
    return {_ports,
            _linkPorts,
            _queue,
            _clock,
            {_clock, _resources, _bundle, _notices},
            technologiesWithSnapshots(SnapshotDisplays::Together),
            _localPortName};
}

bool BrowseLink::childHasEnded() const {
    if (_child == nullptr) {
        return false;
    }
    siginfo_t info{};
    const auto process = static_cast<id_t>(_child->processId());
    return ::waitid(P_PID, process, &info, WEXITED | WNOHANG | WNOWAIT) == 0 && info.si_pid != 0;
}

} // namespace pallax
