#pragma once

#include "host/Descriptor.h"
#include "platform/MessagePort.h"

#include <chrono>
#include <memory>
#include <string>

namespace pallax {

class AsioMainQueue;
class SourceTimeListener;

/// A named port: a listening socket and its connections. Destruction ends it without calling the
/// invalidation callback.
class SocketLocalPort final : public LocalMessagePort {
public:
    struct Setup {
        AsioMainQueue& queue;
        std::string path;
        Descriptor listener; ///< listens at `path`
        MessagePorts::ReceiveCallback receive;
        SourceTimeListener* times; ///< may be null
        /// How long a connection without data is left alone, so that the frames that come meanwhile
        /// are handled together: waking up costs more than handling a frame. Zero: never.
        std::chrono::milliseconds pause{0};
    };

    /// An inert port, which was never valid.
    SocketLocalPort() = default;
    explicit SocketLocalPort(Setup setup);
    ~SocketLocalPort() override;
    SocketLocalPort(const SocketLocalPort&) = delete;
    SocketLocalPort& operator=(const SocketLocalPort&) = delete;

    void setInvalidationCallback(InvalidationCallback callback) override;
    void invalidate() override;
    bool isValid() const override { return _state != nullptr; }
    void setDispatchQueue(MainQueue& queue) override;

private:
    struct State;
    class Session;

    void close();

    std::shared_ptr<State> _state; // null once the port has ended
    InvalidationCallback _invalidated;
};

} // namespace pallax
