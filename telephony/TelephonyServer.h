#pragma once

#include "host/HostError.h"
#include "platform/Bytes.h"
#include "platform/Result.h"
#include "telephony/ControlMessages.h"
#include "telephony/PacketPlayer.h"
#include "telephony/PacketSource.h"

#include <functional>
#include <map>
#include <memory>
#include <string>

namespace pallax {

class AsioMainQueue;
class LocalMessagePort;
class ServedChannel;
class SocketMessagePorts;

/// The stand-in telephony service: a control port on which clients ask for log channels, and the
/// channels, each with a source and a port of its own. Its destruction ends them all.
class TelephonyServer {
public:
    struct Setup {
        AsioMainQueue& queue;
        SocketMessagePorts& ports;
        std::string controlPortName = std::string(kTelephonyControlPort);
        PacketSourceFactory makeSource;
        PlayOptions options;
        /// Hears, as one sentence, what goes wrong with a source once channels are served.
        std::function<void(const std::string& sentence)> report;
    };

    /// Fails when the control port cannot be made, or a living service has that name.
    static Result<std::unique_ptr<TelephonyServer>, HostError> start(Setup setup);
    ~TelephonyServer();
    TelephonyServer(const TelephonyServer&) = delete;
    TelephonyServer& operator=(const TelephonyServer&) = delete;

    std::size_t channelCount() const { return _channels.size(); }

private:
    explicit TelephonyServer(Setup setup);
    std::optional<ByteBuffer> answer(Bytes request);
    LogChannel createLogChannel(const std::string& localPortName);
    void report(const std::string& sentence) const;

    Setup _setup;
    std::unique_ptr<LocalMessagePort> _control;
    std::map<int, std::unique_ptr<ServedChannel>> _channels; // by number
    int _latestNumber = 0;
};

} // namespace pallax
