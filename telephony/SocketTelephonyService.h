#pragma once

#include "platform/MessagePort.h"
#include "platform/TelephonyService.h"
#include "telephony/ControlMessages.h"

#include <string>

namespace pallax {

/// The telephony service for clients, over message ports.
class SocketTelephonyService final : public TelephonyService {
public:
    /// `ports` must outlive the service.
    explicit SocketTelephonyService(
        MessagePorts& ports, std::string controlPortName = std::string(kTelephonyControlPort))
        : _ports(ports), _controlPortName(std::move(controlPortName)) {}

    /// The notification says that the service has gone.
    std::unique_ptr<HXServerConnection> connect(std::function<void()> notification) override;

private:
    MessagePorts& _ports;
    std::string _controlPortName;
};

} // namespace pallax
