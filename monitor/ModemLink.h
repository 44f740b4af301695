#pragma once

#include "LogGenerator/LogGenerator.h"
#include "platform/MessagePort.h"
#include "platform/RepeatingTimer.h"
#include "plist/PropertyList.h"
#include "plist/PropertyListCodec.h"

#include <chrono>
#include <memory>
#include <span>
#include <string>
#include <string_view>

namespace pallax {

class MainQueue;
class TelephonyService;

/// The owner of a link. It keeps the generator that the link makes, and gets the packets. The link
/// calls it on the main queue; it must not destroy the link during a call.
class ModemLinkClient {
public:
    virtual ~ModemLinkClient() = default;
    /// Whether to accept the technology that the modem answered. If not, the link treats the answer
    /// as missing.
    virtual bool wantsTechnology(const PropertyList& /*technology*/) { return true; }
    /// Replaces the generator; null if no generator knows the technology.
    virtual void setGenerator(std::unique_ptr<LogGenerator> generator) = 0;
    /// The generator that was set last, or null.
    virtual const LogGenerator* generator() const = 0;
    /// Called after `setGenerator` with the technology of the generator.
    virtual void generatorChosen(const std::string& /*technology*/) {}
    /// One packet of the log channel. Exceptions pass through the main queue.
    virtual void packetArrived(Bytes packet) = 0;
    /// Called every 2 seconds while the link runs, and when the telephony service reports a change.
    virtual void displayTick() {}
};

/// The link to the baseband: opens a local port and a log channel, asks the modem for its
/// technology, makes the generator, sends its start command, and delivers the packets. A failure
/// while starting tears the link down; it starts again 5 seconds later, without limit. When the
/// peer ends, the link restarts at once.
class ModemLink {
public:
    static constexpr std::string_view kLocalPortName = "com.norvane.BasebandStateReport.LogChannel";
    static constexpr std::chrono::seconds kDisplayInterval{2};
    static constexpr std::chrono::seconds kRetryDelay{5};

    /// The services that the link uses. They must outlive it.
    struct Platform {
        MessagePorts& ports;
        TelephonyService& telephony;
        MainQueue& queue;
        TimerScheduler& timers;
        GeneratorEnvironment generators;
        std::span<const Technology> technologies;
        std::string_view localPortName = kLocalPortName;
        std::chrono::nanoseconds retryDelay = kRetryDelay;
        /// How commands are written.
        Result<std::string, CodecError> (*serialize)(const PropertyList&) = serializeXml;
    };

    /// Does not start the link. `client` must outlive it.
    ModemLink(const Platform& platform, ModemLinkClient& client);
    ~ModemLink();
    ModemLink(const ModemLink&) = delete;
    ModemLink& operator=(const ModemLink&) = delete;

    /// Does nothing while the link runs.
    void startMonitor();
    void restartMonitor();
    /// Logs and returns false when a port, the connection or the channel cannot be opened.
    bool createPorts();
    void destroyPorts();
    /// Asks for the technology and gives the client its generator. Logs a failure, after which the
    /// client keeps its generator.
    void configureGenerator();
    /// True while both ports exist.
    bool isConnected() const;
    /// Restarts the link if the modem's port has ended, then calls the client's display tick.
    void refresh();

private:
    /// False when any step fails.
    bool start();
    bool createChannel(const std::string& localPortName);
    /// The technology that the modem answers. Logs and returns null when it answers none.
    PropertyList askTechnology();
    bool sendStartCommand();
    void retryLater();

    Platform _platform;
    ModemLinkClient& _client;
    std::unique_ptr<LocalMessagePort> _recvPort;
    std::unique_ptr<RemoteMessagePort> _sendPort;
    /// Exists while the link runs.
    std::unique_ptr<RepeatingTimer> _displayUpdateTimer;
    /// Retries hold it weakly, so they do nothing after the link's end.
    std::shared_ptr<ModemLink*> _alive;
};

} // namespace pallax
