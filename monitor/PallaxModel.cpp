#include "monitor/PallaxModel.h"

#include "platform/MainQueue.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyService.h"
#include "plist/PropertyListCodec.h"

#include <string>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kTechnologyKey = "GetTechnology";
constexpr std::int32_t kMessageIdentifier = 0;
constexpr std::chrono::seconds kSendTimeout{1};
constexpr std::chrono::seconds kReplyTimeout{1};

template <class... Arguments>
void logError(std::string_view format, const Arguments&... arguments) {
    systemLog(LogPriority::Error, format, arguments...);
}

const void* address(const MessagePort* port) {
    return port;
}

/// One request to the modem; without a port nobody is there to take it.
RemoteMessagePort::Outcome send(RemoteMessagePort* port, const std::string& xml, bool awaitReply) {
    if (port == nullptr) {
        return {SendError::InvalidPort, std::nullopt};
    }
    const ByteBuffer data(xml.begin(), xml.end());
    RemoteMessagePort::Request request;
    request.identifier = kMessageIdentifier;
    request.data = data;
    request.sendTimeout = kSendTimeout;
    request.replyTimeout = awaitReply ? kReplyTimeout : std::chrono::seconds{0};
    request.awaitReply = awaitReply;
    return port->sendRequest(request);
}

/// The technology that a parsed reply names; null when it names none.
PropertyList technologyOf(const PropertyList& reply) {
    const DictionaryRef dictionary = reply.dictionary();
    const PropertyList* answer = dictionary ? dictionary->find(kTechnologyKey) : nullptr;
    return answer != nullptr ? *answer : PropertyList();
}

} // namespace

PallaxModel::PallaxModel(const Platform& platform)
    : _platform(platform), _alive(std::make_shared<PallaxModel*>(this)) {}

PallaxModel::~PallaxModel() {
    _alive.reset();
    destroyPorts();
}

void PallaxModel::startMonitor() {
    if (_displayUpdateTimer) {
        return;
    }
    if (!createPorts()) {
        logError("Could not create the ports necessary");
        return retryLater();
    }
    configureGenerator();
    if (!_logGenerator) {
        logError("No log generator technology works");
        return retryLater();
    }
    const auto command = _platform.serialize(_logGenerator->getStartCommand());
    if (!command) {
        logError(" Could not generate PLIST");
        return retryLater();
    }
    const SendError error = send(_sendPort.get(), *command, false).error;
    if (error != SendError::None) {
        logError(" ***** Could not send the START command (got error=%d)",
                 static_cast<std::int32_t>(error));
        return retryLater();
    }
    logError("Starting the display update timer");
    _displayUpdateTimer =
        _platform.timers.scheduleRepeating(kDisplayInterval, [this] { refresh(); });
}

void PallaxModel::restartMonitor() {
    destroyPorts();
    startMonitor();
}

void PallaxModel::retryLater() {
    destroyPorts();
    _platform.queue.after(_platform.retryDelay, [model = std::weak_ptr(_alive)] {
        if (const auto alive = model.lock()) {
            (*alive)->startMonitor();
        }
    });
}

bool PallaxModel::createPorts() {
    const std::string name(_platform.localPortName);
    auto local = _platform.ports.createLocal(name, [this](std::int32_t identifier, Bytes data) {
        packetReceived(identifier, data);
        return std::optional<ByteBuffer>();
    });
    _recvPort = std::move(local.port);
    if (!_recvPort) {
        logError("Could not create local message port");
        return false;
    }
    if (local.alreadyExisted) {
        logError("Local messsage port already exists");
        return false;
    }
    _recvPort->setDispatchQueue(_platform.queue);
    _recvPort->setInvalidationCallback([this](MessagePort& port) { portInvalidated(port); });

    auto connection = _platform.telephony.connect([this] { refresh(); });
    if (!connection) {
        logError("Could not create HXServerConnection");
        return false;
    }
    const LogChannel channel = connection->HXServerConnectionNetworkMonitorCreateLogChannel(name);
    connection.reset(); // the channel outlives it
    if (channel.errorCode != 0) {
        logError("_HXServerConnectionNetworkMonitorCreateLogChannel returns error: %ld!",
                 channel.errorCode);
        return false;
    }
    if (!channel.remotePortName || channel.remotePortName->empty()) {
        logError("Could not create a log channel (HX returned null port)!");
        return false;
    }
    _sendPort = _platform.ports.createRemote(*channel.remotePortName);
    if (!_sendPort) {
        logError("Could not create the remote port!");
        return false;
    }
    logError(" ***** Created ports (send=%p, recv=%p)", address(_sendPort.get()),
             address(_recvPort.get()));
    return true;
}

void PallaxModel::destroyPorts() {
    if (_displayUpdateTimer) {
        _displayUpdateTimer->invalidate();
        _displayUpdateTimer.reset();
    }
    // The callback goes first: a teardown of our own must not restart the monitor.
    const auto end = [](auto& port) {
        if (port) {
            port->setInvalidationCallback({});
            port->invalidate();
            port.reset();
        }
    };
    end(_recvPort);
    end(_sendPort);
}

void PallaxModel::configureGenerator() {
    const auto query = _platform.serialize(Dictionary{{kTechnologyKey, kTechnologyKey}});
    if (!query) {
        logError(" Could not generate GetTechnology command; cannot configure");
        return;
    }
    const auto outcome = send(_sendPort.get(), *query, true);
    if (outcome.error != SendError::None) {
        logError(" ***** Could not send the GetTechnology command (got error=%d)",
                 static_cast<std::int32_t>(outcome.error));
        return;
    }
    if (!outcome.reply || outcome.reply->empty()) {
        logError(" ***** No response to GetTechnology; cannot configure");
        return;
    }
    const auto reply = parsePropertyList(*outcome.reply);
    if (!reply) {
        logError(" ***** Could not parse reply to GetTechnology; cannot configure");
        return;
    }
    const PropertyList technology = technologyOf(*reply);
    if (technology.isNull()) {
        logError(" ***** Reply to GetTechnology had no answer; cannot configure");
        return;
    }
    _logGenerator = LogGenerator::generatorFromTechnology(technology, _platform.technologies,
                                                          _platform.generators);
    logError("Got log generated: %p", static_cast<const void*>(_logGenerator.get()));
    if (_logGenerator) {
        std::string name;
        (void)technology.appendString(name);
        _platform.observer.generatorChosen(name, _logGenerator->keepsDisplay(_state));
    }
}

bool PallaxModel::isConnected() const {
    return _recvPort && _sendPort;
}

void PallaxModel::packetReceived(std::int32_t identifier, Bytes data) {
    if (identifier == kMessageIdentifier) {
        updateWithData(data);
    }
}

void PallaxModel::portInvalidated(const MessagePort& port) {
    logError(" ***** INVALIDATED %p *****", address(&port));
    restartMonitor();
}

void PallaxModel::updateWithData(Bytes data) {
    if (_logGenerator) {
        _logGenerator->updateState(_state, data);
    }
    _updated = true;
}

void PallaxModel::refresh() {
    if (isConnected() && !_sendPort->isValid()) {
        _recvPort->invalidate(); // its invalidation callback restarts the monitor
    }
    if (!_updated) {
        return;
    }
    _updated = false;
    _nodes.reset();
    _nodesByPath.reset();
    _platform.queue.async([model = std::weak_ptr(_alive)] {
        if (const auto alive = model.lock()) {
            (*alive)->_platform.observer.updateViewControllerFromModel();
        }
    });
}

NodeRef PallaxModel::topLevelNodes() {
    if (_nodes || _nodesByPath) { // paths without a root: the display was asked for, and is null
        return _nodes;
    }
    if (!_logGenerator) {
        return nullptr;
    }
    const PropertyList display = _logGenerator->generateLogUsingState(_state);
    auto paths = std::make_unique<PathDictionary>();
    _nodes = PallaxModelNode::makeTreeFromObject(display, *paths);
    _nodesByPath = std::move(paths);
    return _nodes;
}

NodeRef PallaxModel::nodeAtPath(std::string_view path) {
    if (!_nodesByPath) {
        topLevelNodes();
    }
    if (!_nodesByPath) {
        return nullptr;
    }
    const auto found = _nodesByPath->find(std::string(path));
    return found != _nodesByPath->end() ? found->second : nullptr;
}

PropertyList PallaxModel::getSaveContents() const {
    return _logGenerator ? _logGenerator->getSaveContentsFromState(_state) : PropertyList();
}

PropertyList PallaxModel::display() {
    return _logGenerator ? _logGenerator->display(_state) : PropertyList();
}

} // namespace pallax
