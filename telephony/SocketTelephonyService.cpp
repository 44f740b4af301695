#include "telephony/SocketTelephonyService.h"

#include <cerrno>

namespace pallax {

namespace {

class SocketServerConnection final : public HXServerConnection {
public:
    explicit SocketServerConnection(std::unique_ptr<RemoteMessagePort> port)
        : _port(std::move(port)) {}

    LogChannel
    HXServerConnectionNetworkMonitorCreateLogChannel(std::string_view localPortName) override;

private:
    std::unique_ptr<RemoteMessagePort> _port;
};

LogChannel SocketServerConnection::HXServerConnectionNetworkMonitorCreateLogChannel(
    std::string_view localPortName) {
    constexpr std::chrono::seconds kTimeout{1};
    const auto bytes = encodeMessage(createLogChannelRequest(localPortName));
    if (!bytes) {
        return {kServiceErrorDomain, EINVAL, {}};
    }
    const auto outcome = _port->sendRequest({0, *bytes, kTimeout, kTimeout, true});
    if (outcome.error != SendError::None) {
        return {kPortErrorDomain, static_cast<std::int32_t>(outcome.error), {}};
    }
    const auto message = outcome.reply ? decodeMessage(*outcome.reply) : std::nullopt;
    auto channel = message ? parseCreateLogChannelReply(*message) : std::nullopt;
    return channel ? std::move(*channel) : LogChannel{kServiceErrorDomain, EPROTO, {}};
}

} // namespace

std::unique_ptr<HXServerConnection>
SocketTelephonyService::connect(std::function<void()> notification) {
    auto port = _ports.createRemote(_controlPortName);
    if (port == nullptr) {
        return nullptr;
    }
    port->setInvalidationCallback([notification = std::move(notification)](MessagePort& /*port*/) {
        if (notification) {
            notification();
        }
    });
    return std::make_unique<SocketServerConnection>(std::move(port));
}

} // namespace pallax
