#include "live/LiveSession.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "console/ScopedLog.h"
#include "host/Complaint.h"
#include "host/LogSinks.h"
#include "link/PacketReceiver.h"
#include "link/WaitNotice.h"
#include "text/Format.h"

#include <utility>

namespace pallax {

std::string noPacketText(const std::string& service) {
    return service.empty() ? "No packet has come from the live modem."
                           : formatText("No packet has come from %@.", {service});
}

LiveSession::LiveSession(Setup setup)
    : _setup(std::move(setup)), _resources(DirectoryResources::programFolder()) {}

std::optional<std::string> LiveSession::run() {
    auto directory = SocketDirectory::open(_setup.service);
    if (!directory) {
        return directory.error().sentence;
    }
    SyslogSink syslog("pallax");
    const ScopedLog log(syslog, _setup.settings.systemLogLevel);
    return receive(std::move(directory).value());
}

std::optional<std::string> LiveSession::receive(SocketDirectory directory) {
    PacketReceiver receiver({std::move(directory), "Timeline", _setup.wanted,
                             [this](const RecordedTechnology& technology, Time stamp,
                                    Bytes packet) { _timeline->add(technology, stamp, packet); },
                             complainOfWaiting, _setup.duration});
    const auto indexed = [this, &receiver](Timeline& timeline) {
        _setup.indexed(timeline);
        if (timeline.hasEnded()) {
            receiver.stop();
        }
    };
    _timeline = std::make_unique<LiveTimeline>(
        LiveTimeline::Setup{receiver.queue(), _resources, _bundle, technologies(),
                            _setup.settings.journal, complain, indexed});
    auto failure = receiver.run();
    _timeline->finish();
    return failure;
}

} // namespace pallax
