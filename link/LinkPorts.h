#pragma once

#include "platform/MessagePort.h"
#include "platform/TelephonyService.h"

#include <functional>
#include <string>

namespace pallax {

/// What a model's link goes over. It chooses at each start which local port name stands for the
/// model's fixed one, and remembers what the latest start has failed at.
///
/// The first viewer of a service has the fixed name. Where a living viewer has it, this one uses a
/// name of its own, and tells the service that name instead.
class LinkPorts final : public MessagePorts, public TelephonyService {
public:
    struct Setup {
        MessagePorts& ports;
        TelephonyService& telephony;
        std::string ownLocalName; ///< no other process has it
        /// Why the latest createLocal gave no port: one sentence.
        std::function<std::string()> whyNoPort;
        /// Whether there is a service, even one that takes no connection now.
        std::function<bool()> isServiceThere;
    };

    /// What the setup refers to outlives the ports.
    explicit LinkPorts(Setup setup) : _setup(std::move(setup)) {}

    Local createLocal(std::string_view name, ReceiveCallback receive) override;
    std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) override;
    std::unique_ptr<HXServerConnection> connect(std::function<void()> notification) override;

    /// What the latest start has come to last ("No telephony service is running"), for a link that
    /// does not stand; empty before the first start.
    const std::string& obstacle() const { return _obstacle; }

private:
    class Connection;

    Setup _setup;
    std::string _localName; ///< that stands for the model's
    std::string _obstacle;
};

} // namespace pallax
