#pragma once

#include "host/Descriptor.h"
#include "platform/MessagePort.h"

#include <memory>

namespace pallax {

class AsioMainQueue;

/// A connection to a named port. Requests go one at a time; replies are matched to requests by
/// number, so a late reply is dropped. When the peer ends the connection, the port becomes invalid
/// and calls the invalidation callback as a block of the queue.
class SocketRemotePort final : public RemoteMessagePort {
public:
    SocketRemotePort(AsioMainQueue& queue, Descriptor socket);
    ~SocketRemotePort() override;
    SocketRemotePort(const SocketRemotePort&) = delete;
    SocketRemotePort& operator=(const SocketRemotePort&) = delete;

    void setInvalidationCallback(InvalidationCallback callback) override;
    void invalidate() override;
    bool isValid() const override;
    Outcome sendRequest(const Request& request) override;

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace pallax
