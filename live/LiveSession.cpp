#include "live/LiveSession.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "console/ScopedLog.h"
#include "host/Complaint.h"
#include "host/LogSinks.h"
#include "link/PacketReceiver.h"
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

void LiveSession::add(const RecordedTechnology& technology, Time stamp, Bytes packet) {
    if (_setup.masked) {
        _timeline->add(technology, stamp, _setup.masked(technology, packet));
    } else {
        _timeline->add(technology, stamp, packet);
    }
}

std::optional<std::string> LiveSession::receive(SocketDirectory directory) {
    PacketReceiver receiver({std::move(directory), "Timeline", _setup.wanted,
                             [this](const RecordedTechnology& technology, Time stamp,
                                    Bytes packet) { add(technology, stamp, packet); },
                             _setup.waits, _setup.duration, _setup.child, _setup.lostChild,
                             _setup.ended});
    const auto indexed = [this, &receiver](Timeline& timeline) {
        _setup.indexed(timeline);
        if (timeline.hasEnded() && !_setup.ended) {
            receiver.stop();
        }
    };
    _timeline =
        std::make_unique<LiveTimeline>(LiveTimeline::Setup{.queue = receiver.queue(),
                                                           .resources = _resources,
                                                           .bundle = _bundle,
                                                           .technologies = technologies(),
                                                           .journal = _setup.settings.journal,
                                                           .report = complain,
                                                           .indexed = indexed,
                                                           .replaced = _setup.replaced});
    const auto served = _setup.began ? _setup.began(receiver.queue()) : nullptr;
    auto failure = receiver.run();
    _timeline->finish();
    return failure;
}

} // namespace pallax
