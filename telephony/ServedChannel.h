#pragma once

#include "sources/PacketSource.h"
#include "telephony/PacketPlayer.h"
#include "telephony/ServiceStatus.h"
#include "telephony/SocketSink.h"

#include <functional>
#include <memory>
#include <string>

namespace pallax {

class LocalMessagePort;
class SocketMessagePorts;

/// One log channel of the service: answers GetTechnology on its port, and streams to its client
/// after the start command. It lasts until the client closes the connection that it feeds, or the
/// source has another technology.
class ServedChannel {
public:
    struct Setup {
        AsioMainQueue& queue;
        SocketMessagePorts& ports;
        std::string portName;         ///< of the channel's own port
        std::string receiverPortName; ///< of the client's local port
        std::unique_ptr<PacketSource> source;
        PlayOptions options;
        /// See SocketSink.
        std::optional<std::size_t> mostWaiting;
        /// Receives a sentence when a client becomes slow or recovers.
        std::function<void(const std::string& sentence)> report;
        /// The client has gone; may destroy the channel.
        std::function<void()> closed;
        /// The source has another technology; may destroy the channel, whose client then asks anew.
        std::function<void()> technologyChanged;
        /// The source has ended, with its failure or an empty text.
        std::function<void(const std::string& failure)> ended;
    };

    /// Zero, or the errno of the failure (then `channel` stays empty).
    static int open(Setup setup, std::unique_ptr<ServedChannel>& channel);
    ~ServedChannel();
    ServedChannel(const ServedChannel&) = delete;
    ServedChannel& operator=(const ServedChannel&) = delete;

    ServiceStatus::Client status() const;
    /// Whether the start command has arrived.
    bool hasStarted() const { return _hasStarted; }
    const std::string& receiverPortName() const { return _receiverPortName; }
    /// Bytes sent that the client has not read yet.
    std::size_t untaken() const { return _sink->untaken(); }

private:
    ServedChannel(std::unique_ptr<PacketSource> source, std::unique_ptr<SocketSink> sink,
                  std::string receiverPortName);
    std::optional<ByteBuffer> answer(Bytes request);

    std::unique_ptr<PacketSource> _source;
    std::unique_ptr<SocketSink> _sink;
    std::string _receiverPortName;
    bool _hasStarted = false;
    bool _isStreaming = false;
    bool _hasEnded = false;
    std::unique_ptr<PacketPlayer> _player;
    std::unique_ptr<LocalMessagePort> _port;
};

} // namespace pallax
