#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// The result of a request for a log channel.
struct LogChannel {
    std::int32_t errorDomain = 0;
    std::int32_t errorCode = 0; ///< non-zero on failure
    std::optional<std::string> remotePortName;
};

/// An open connection to the telephony service; destruction closes it.
class HXServerConnection {
public:
    virtual ~HXServerConnection() = default;
    /// Creates a network-monitor log channel that feeds the local port with this name. (The
    /// operation's leading underscore is omitted because such names are reserved.)
    virtual LogChannel
    HXServerConnectionNetworkMonitorCreateLogChannel(std::string_view localPortName) = 0;
};

/// The telephony service as its clients see it.
class TelephonyService {
public:
    virtual ~TelephonyService() = default;
    /// Null if the service cannot be reached. `notification` is called on the main queue during the
    /// connection's lifetime.
    virtual std::unique_ptr<HXServerConnection> connect(std::function<void()> notification) = 0;
};

} // namespace pallax
