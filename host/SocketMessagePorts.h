#pragma once

#include "host/SocketDirectory.h"
#include "platform/MessagePort.h"

#include <chrono>
#include <string>

namespace pallax {

class AsioMainQueue;
class SourceTimeListener;

/// Named message ports as Unix-domain sockets. A port reads messages only as fast as they are
/// processed, so a slow receiver slows its senders down. Apart from delivering messages, ports work
/// on `queue`. Queue and listener must outlive the ports.
class SocketMessagePorts final : public MessagePorts {
public:
    /// `listener`, which may be null, receives the source times that arrive on local ports.
    SocketMessagePorts(AsioMainQueue& queue, SocketDirectory directory,
                       SourceTimeListener* listener = nullptr);

    Local createLocal(std::string_view name, ReceiveCallback receive) override;
    std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) override;

    /// As SocketLocalPort::Setup, for the local ports that follow.
    void setPause(std::chrono::milliseconds pause) { _pause = pause; }

    /// Whether a living port has this name, even if it accepts no connection now.
    bool isTaken(std::string_view name) const;
    /// Why the latest createLocal failed: one sentence.
    const std::string& lastError() const { return _lastError; }
    const SocketDirectory& directory() const { return _directory; }

private:
    AsioMainQueue& _queue;
    SocketDirectory _directory;
    SourceTimeListener* _listener;
    std::chrono::milliseconds _pause{0};
    std::string _lastError;
};

} // namespace pallax
