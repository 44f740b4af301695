#pragma once

#include "decoding/FatalRecord.h"
#include "decoding/RequiredTemplates.h"
#include "host/AsioMainQueue.h"
#include "host/BuildBundle.h"
#include "host/SocketMessagePorts.h"
#include "host/SourceClock.h"
#include "host/WallClock.h"
#include "link/LinkPorts.h"
#include "monitor/ModemLink.h"
#include "telephony/SocketTelephonyService.h"

#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>

namespace pallax {

class ChildService;
class StandardOutput;

/// The parts of this machine that a model needs to browse: the ports to the telephony service (a
/// child's or the machine's), the source's clock, and the templates, all on a main queue, which
/// several links can share.
class BrowseLink {
public:
    /// How often a browser checks the connection, and whether the child service is still running.
    static constexpr std::chrono::milliseconds kLookInterval{500};

    /// `child` is null for the machine's own service; a child's clients have private port names,
    /// made from `localPortName`. If that name is taken, the link has another one for this process
    /// (see LinkPorts). References must outlive the link.
    BrowseLink(AsioMainQueue& queue, SocketDirectory directory, OnFatalRecord onFatalRecord,
               ChildService* child, StandardOutput& notices,
               std::string_view localPortName = ModemLink::kLocalPortName);

    AsioMainQueue& queue() { return _queue; }
    SourceClock& clock() { return _clock; }
    const SourceClock& clock() const { return _clock; }
    const Clock& present() const { return _wallClock; }
    const Resources& resources() const { return _resources; }
    const Bundle& bundle() const { return _bundle; }
    ModemLink::Platform platform();
    /// See LinkPorts.
    void setFilter(LinkPorts::PacketFilter filter) { _linkPorts.setFilter(std::move(filter)); }
    /// See SocketMessagePorts.
    void setPause(std::chrono::milliseconds pause) { _socketPorts.setPause(pause); }
    /// See LinkPorts.
    void setTap(LinkPorts::PacketTap tap) { _linkPorts.setTap(std::move(tap)); }
    /// See LinkPorts.
    const std::string& obstacle() const { return _linkPorts.obstacle(); }

    /// See LinkPorts.
    std::string_view briefObstacle() const { return _linkPorts.briefObstacle(); }
    std::uint64_t received() const { return _linkPorts.received(); }

    bool hasChild() const { return _child != nullptr; }
    /// True once the child has ended; its owner must reap it.
    bool childHasEnded() const;

private:
    ChildService* _child;
    StandardOutput& _notices;
    std::string _localPortName;
    AsioMainQueue& _queue;
    WallClock _wallClock;
    SourceClock _clock;
    std::string _controlPortName;
    SocketMessagePorts _socketPorts;
    SocketTelephonyService _telephony;
    LinkPorts _linkPorts;
    GuardedMessagePorts _ports;
    RequiredTemplates _resources;
    BuildBundle _bundle;
};

} // namespace pallax
