#include "recording/RecordingPorts.h"

#include <utility>

namespace pallax {

namespace {

/// Shows the replies to the listener.
class OverheardPort final : public RemoteMessagePort {
public:
    OverheardPort(std::unique_ptr<RemoteMessagePort> port, LinkListener& listener)
        : _port(std::move(port)), _listener(listener) {}

    void setInvalidationCallback(InvalidationCallback callback) override {
        if (!callback) {
            _port->setInvalidationCallback({});
            return;
        }
        _port->setInvalidationCallback(
            [this, callback = std::move(callback)](MessagePort& /*port*/) { callback(*this); });
    }
    void invalidate() override { _port->invalidate(); }
    bool isValid() const override { return _port->isValid(); }
    Outcome sendRequest(const Request& request) override {
        Outcome outcome = _port->sendRequest(request);
        if (outcome.reply && !_listener.replied(*outcome.reply)) {
            outcome.reply.reset();
        }
        return outcome;
    }

private:
    std::unique_ptr<RemoteMessagePort> _port;
    LinkListener& _listener;
};

} // namespace

MessagePorts::Local RecordingPorts::createLocal(std::string_view name,
                                                ReceiveCallback /*receive*/) {
    return _ports.createLocal(name, [this](std::int32_t identifier, Bytes data) {
        if (identifier == 0) {
            _listener.packetArrived(data);
        }
        return std::optional<ByteBuffer>();
    });
}

std::unique_ptr<RemoteMessagePort> RecordingPorts::createRemote(std::string_view name) {
    auto port = _ports.createRemote(name);
    return port ? std::make_unique<OverheardPort>(std::move(port), _listener) : nullptr;
}

} // namespace pallax
