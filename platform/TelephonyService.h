#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// What the request for a log channel gave.
struct LogChannel {
    std::int32_t errorDomain = 0;
    std::int32_t errorCode = 0; ///< non-zero on failure
    std::optional<std::string> remotePortName;
};

/// An open connection to the telephony service; its destruction closes it.
class HXServerConnection {
public:
    virtual ~HXServerConnection() = default;
    /// Creates a network-monitor log channel that feeds the local port of that name. (The
    /// operation's leading underscore is left out: such names belong to the compiler.)
    virtual LogChannel
    HXServerConnectionNetworkMonitorCreateLogChannel(std::string_view localPortName) = 0;
};

/// The telephony service as its clients reach it.
class TelephonyService {
public:
    virtual ~TelephonyService() = default;
    /// Null when the service cannot be reached. `notification` is called on the main queue while
    /// the connection lives.
    virtual std::unique_ptr<HXServerConnection> connect(std::function<void()> notification) = 0;
};

} // namespace pallax
