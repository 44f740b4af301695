#pragma once

#include "host/HostError.h"
#include "plist/PropertyList.h"
#include "text/Result.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

class SocketMessagePorts;

/// The status of a running service:
///
///   to the control port    {"GetStatus": "GetStatus"}
///   its answer             {"Technology": text, "Uptime": seconds, "Sent": packets,
///                           "Dropped": packets, "Clients": [{"LocalPort": name,
///                           "Streaming": boolean, "Sent": packets, "Dropped": packets}]}
struct ServiceStatus {
    struct Client {
        std::string localPort;
        bool isStreaming = false; ///< it has sent its start command
        std::int64_t sent = 0;
        std::int64_t dropped = 0;
        friend bool operator==(const Client&, const Client&) = default;
    };
    std::string technology;
    std::int64_t uptimeSeconds = 0;
    std::int64_t sent = 0;    ///< to all clients, including those that have left
    std::int64_t dropped = 0; ///< likewise
    std::vector<Client> clients;
    friend bool operator==(const ServiceStatus&, const ServiceStatus&) = default;
};

Dictionary statusRequest();
bool isStatusRequest(const Dictionary& message);
Dictionary statusReply(const ServiceStatus& status);
/// Nothing if the reply lacks a value.
std::optional<ServiceStatus> parseStatusReply(const Dictionary& reply);

/// Asks the service at this control port, or says why it cannot. A service that does not answer
/// takes two seconds at most.
Result<ServiceStatus, HostError> askStatus(SocketMessagePorts& ports,
                                           const std::string& controlPortName);
/// The status as lines for the user.
std::string statusText(const ServiceStatus& status);

} // namespace pallax
