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
/// calls it on the main queue, and is not destroyed by it meanwhile.
class ModemLinkClient {
public:
    virtual ~ModemLinkClient() = default;
    /// What the modem has answered. A technology that is not wanted counts as no answer.
    virtual bool wantsTechnology(const PropertyList& /*technology*/) { return true; }
    /// Replaces the generator; null where no generator knows the technology.
    virtual void setGenerator(std::unique_ptr<LogGenerator> generator) = 0;
    /// The generator that was set last, or null.
    virtual const LogGenerator* generator() const = 0;
    /// The generator that was set is one for this technology.
    virtual void generatorChosen(const std::string& /*technology*/) {}
    /// One packet of the log channel. Exceptions leave through the main queue.
    virtual void packetArrived(Bytes packet) = 0;
    /// Every 2 seconds while the link runs, and when the telephony service tells of a change.
    virtual void displayTick() {}
};

/// The link to the baseband: opens a local port and a log channel, asks the modem for its
/// technology, makes that technology's generator, sends its start command, and delivers the
/// packets. Each failure while starting tears the link down; the next start follows 5 seconds
/// later, forever. A link whose peer ends starts anew at once.
class ModemLink {
public:
    static constexpr std::string_view kLocalPortName = "com.norvane.BasebandStateReport.LogChannel";
    static constexpr std::chrono::seconds kDisplayInterval{2};
    static constexpr std::chrono::seconds kRetryDelay{5};

    /// All that it refers to outlives the link.
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

    /// Starts nothing. The client outlives the link.
    ModemLink(const Platform& platform, ModemLinkClient& client);
    ~ModemLink();
    ModemLink(const ModemLink&) = delete;
    ModemLink& operator=(const ModemLink&) = delete;

    /// Does nothing while the link runs.
    void startMonitor();
    void restartMonitor();
    /// False, and logged, when a port, the connection or the channel cannot be had.
    bool createPorts();
    void destroyPorts();
    /// Asks for the technology and gives the client its generator. After a failure, which is
    /// logged, the client keeps the generator that it has.
    void configureGenerator();
    /// True while both ports are there.
    bool isConnected() const;
    /// Starts the link anew if the modem's port has ended; then the client's display tick.
    void refresh();

private:
    /// False when any step fails.
    bool start();
    bool createChannel(const std::string& localPortName);
    /// The technology that the modem answers; null, and logged, when it answers none.
    PropertyList askTechnology();
    bool sendStartCommand();
    void retryLater();

    Platform _platform;
    ModemLinkClient& _client;
    std::unique_ptr<LocalMessagePort> _recvPort;
    std::unique_ptr<RemoteMessagePort> _sendPort;
    /// The link runs while it is there.
    std::unique_ptr<RepeatingTimer> _displayUpdateTimer;
    /// Retries hold it weakly: after the link's end they do nothing.
    std::shared_ptr<ModemLink*> _alive;
};

} // namespace pallax
