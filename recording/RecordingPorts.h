#pragma once

#include "platform/MessagePort.h"

namespace pallax {

/// What goes over a model's link, for whoever records it.
class LinkListener {
public:
    virtual ~LinkListener() = default;
    /// A reply to a request. False: it is withheld, as if none had come.
    virtual bool replied(Bytes reply) = 0;
    /// A message of the log channel.
    virtual void packetArrived(Bytes packet) = 0;
};

/// Message ports that hand a log channel's packets to a listener and to nobody else: the model
/// behind them makes the link, with its retries, the technology query and the start command, and
/// decodes nothing.
class RecordingPorts final : public MessagePorts {
public:
    /// Both outlive the ports.
    RecordingPorts(MessagePorts& ports, LinkListener& listener)
        : _ports(ports), _listener(listener) {}

    Local createLocal(std::string_view name, ReceiveCallback receive) override;
    std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) override;

private:
    MessagePorts& _ports;
    LinkListener& _listener;
};

} // namespace pallax
