#pragma once

#include "platform/MessagePort.h"
#include "platform/TelephonyService.h"

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace pallax {

/// The ports of a model's link. At each start they choose the local port name to use in place of
/// the model's fixed one, and they remember why the latest start failed.
///
/// The first viewer of a service has the fixed name. If a living viewer has it, this one uses its
/// own name and passes that to the service.
class LinkPorts final : public MessagePorts, public TelephonyService {
public:
    struct Setup {
        MessagePorts& ports;
        TelephonyService& telephony;
        std::string ownLocalName; ///< unique to this process
        /// Why the latest createLocal failed: one sentence.
        std::function<std::string()> whyNoPort;
        /// Whether there is a service, even one that accepts no connection now.
        std::function<bool()> isServiceThere;
        std::string serviceName = {}; ///< empty: the service has none
    };

    /// What is delivered in place of a packet.
    using PacketFilter = std::function<ByteBuffer(Bytes packet)>;
    /// Sees each packet as it is delivered, just before.
    using PacketTap = std::function<void(Bytes packet)>;

    /// The references in the setup must outlive the ports.
    explicit LinkPorts(Setup setup);

    Local createLocal(std::string_view name, ReceiveCallback receive) override;
    std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) override;
    std::unique_ptr<HXServerConnection> connect(std::function<void()> notification) override;

    /// Applies to all packets that follow.
    void setFilter(PacketFilter filter) { _filter = std::move(filter); }
    void setTap(PacketTap tap) { _tap = std::move(tap); }

    /// The last problem of the latest start ("No telephony service is running"), for a link that is
    /// not connected; empty before the first start.
    const std::string& obstacle() const { return _obstacle; }
    /// The same in two or three words: "no service".
    std::string_view briefObstacle() const;
    /// The number of messages that have arrived at the local ports.
    std::uint64_t received() const { return _received; }

private:
    class Connection;

    Setup _setup;
    std::string _noService; ///< an obstacle
    PacketFilter _filter;   // may be empty
    PacketTap _tap;         // likewise
    std::string _localName; ///< in place of the model's
    std::string _obstacle;
    std::uint64_t _received = 0;
};

} // namespace pallax
