#pragma once

#include "LogGenerator/LogGenerator.h"
#include "app/tree/PallaxModelNode.h"
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

/// What the model asks of the application object.
class ModelObserver {
public:
    virtual ~ModelObserver() = default;
    /// New data has arrived since the last display tick; called on the main queue.
    virtual void updateViewControllerFromModel() = 0;
    /// A generator for what the modem speaks is in place. `keepsDisplay`: after a restart of the
    /// link the display keeps its values, whatever arrives from now on.
    virtual void generatorChosen(const std::string& /*technology*/, bool /*keepsDisplay*/) {}
};

/// The spine of the system: owns the link to the baseband, chooses the log generator, feeds it
/// every packet, and drives the display refresh every 2 seconds. Whatever fails while starting
/// tears the link down and is tried again 5 seconds later, forever.
class PallaxModel {
public:
    static constexpr std::string_view kLocalPortName = "com.norvane.BasebandStateReport.LogChannel";
    static constexpr std::chrono::seconds kDisplayInterval{2};
    static constexpr std::chrono::seconds kRetryDelay{5};

    /// All of it outlives the model.
    struct Platform {
        MessagePorts& ports;
        TelephonyService& telephony;
        MainQueue& queue;
        TimerScheduler& timers;
        GeneratorEnvironment generators;
        std::span<const Technology> technologies;
        ModelObserver& observer;
        std::string_view localPortName = kLocalPortName;
        std::chrono::nanoseconds retryDelay = kRetryDelay;
        /// How commands are written.
        Result<std::string, CodecError> (*serialize)(const PropertyList&) = serializeXml;
    };

    explicit PallaxModel(const Platform& platform);
    ~PallaxModel();
    PallaxModel(const PallaxModel&) = delete;
    PallaxModel& operator=(const PallaxModel&) = delete;

    void startMonitor();
    void restartMonitor();
    bool createPorts();
    void destroyPorts();
    void configureGenerator();
    bool isConnected() const;

    /// One packet of the log channel. An exception of a record leaves through here.
    void updateWithData(Bytes data);
    void refresh();

    /// The root of the display tree; null while there is no generator. The caller may keep it
    /// beyond the next refresh.
    NodeRef topLevelNodes();
    /// The node that stands at `path` ("/", "/Serving Cell"), or null.
    NodeRef nodeAtPath(std::string_view path);
    /// The generator's save contents (an array), or null without a generator. The sections of their
    /// displays are the live ones, which are up to date after a call of `display`.
    PropertyList getSaveContents() const;
    /// The live display, with every packet that has arrived; null while there is none.
    PropertyList display();

private:
    void retryLater();
    void packetReceived(std::int32_t identifier, Bytes data);
    void portInvalidated(const MessagePort& port);

    Platform _platform;
    std::unique_ptr<LocalMessagePort> _recvPort;
    std::unique_ptr<RemoteMessagePort> _sendPort;
    std::unique_ptr<RepeatingTimer> _displayUpdateTimer;
    bool _updated = false;
    std::unique_ptr<LogGenerator> _logGenerator;
    Dictionary _state;
    NodeRef _nodes;
    std::unique_ptr<PathDictionary> _nodesByPath;
    /// Blocks on the queue hold it weakly: after the model's end they do nothing.
    std::shared_ptr<PallaxModel*> _alive;
};

} // namespace pallax
