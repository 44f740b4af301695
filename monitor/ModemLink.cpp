#include "monitor/ModemLink.h"

#include "platform/MainQueue.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyService.h"

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

/// Sends a request to the modem. Fails without a port.
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

ModemLink::ModemLink(const Platform& platform, ModemLinkClient& client)
    : _platform(platform), _client(client), _alive(std::make_shared<ModemLink*>(this)) {}

ModemLink::~ModemLink() {
    _alive.reset();
    destroyPorts();
}

void ModemLink::startMonitor() {
    if (!_displayUpdateTimer && !start()) {
        retryLater();
    }
}

bool ModemLink::start() {
    if (!createPorts()) {
        logError("Could not create the ports necessary");
        return false;
    }
    configureGenerator();
    if (_client.generator() == nullptr) {
        logError("No log generator technology works");
        return false;
    }
    if (!sendStartCommand()) {
        return false;
    }
    logError("Starting the display update timer");
    _displayUpdateTimer =
        _platform.timers.scheduleRepeating(kDisplayInterval, [this] { refresh(); });
    return true;
}

void ModemLink::restartMonitor() {
    destroyPorts();
    startMonitor();
}

void ModemLink::retryLater() {
    destroyPorts();
    _platform.queue.after(_platform.retryDelay, [link = std::weak_ptr(_alive)] {
        if (const auto alive = link.lock()) {
            (*alive)->startMonitor();
        }
    });
}

bool ModemLink::createPorts() {
    const std::string name(_platform.localPortName);
    auto local = _platform.ports.createLocal(name, [this](std::int32_t identifier, Bytes data) {
        if (identifier == kMessageIdentifier) {
            _client.packetArrived(data);
        }
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
    _recvPort->setInvalidationCallback([this](MessagePort& port) {
        logError(" ***** INVALIDATED %p *****", address(&port));
        restartMonitor();
    });
    return createChannel(name);
}

bool ModemLink::createChannel(const std::string& localPortName) {
    auto connection = _platform.telephony.connect([this] { refresh(); });
    if (!connection) {
        logError("Could not create HXServerConnection");
        return false;
    }
    const LogChannel channel =
        connection->HXServerConnectionNetworkMonitorCreateLogChannel(localPortName);
    connection.reset(); // the channel stays open
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

void ModemLink::destroyPorts() {
    if (_displayUpdateTimer) {
        _displayUpdateTimer->invalidate();
        _displayUpdateTimer.reset();
    }
    // The callback is removed first: our own teardown must not restart the link.
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

PropertyList ModemLink::askTechnology() {
    const auto query = _platform.serialize(Dictionary{{kTechnologyKey, kTechnologyKey}});
    if (!query) {
        logError(" Could not generate GetTechnology command; cannot configure");
        return {};
    }
    const auto outcome = send(_sendPort.get(), *query, true);
    if (outcome.error != SendError::None) {
        logError(" ***** Could not send the GetTechnology command (got error=%d)",
                 static_cast<std::int32_t>(outcome.error));
        return {};
    }
    constexpr std::string_view kNoResponse =
        " ***** No response to GetTechnology; cannot configure";
    if (!outcome.reply || outcome.reply->empty()) {
        logError(kNoResponse);
        return {};
    }
    const auto reply = parsePropertyList(*outcome.reply);
    if (!reply) {
        logError(" ***** Could not parse reply to GetTechnology; cannot configure");
        return {};
    }
    PropertyList technology = technologyOf(*reply);
    if (technology.isNull()) {
        logError(" ***** Reply to GetTechnology had no answer; cannot configure");
    } else if (!_client.wantsTechnology(technology)) {
        logError(kNoResponse);
        return {};
    }
    return technology;
}

void ModemLink::configureGenerator() {
    const PropertyList technology = askTechnology();
    if (technology.isNull()) {
        return;
    }
    auto made = LogGenerator::generatorFromTechnology(technology, _platform.technologies,
                                                      _platform.generators);
    const LogGenerator* generator = made.get();
    _client.setGenerator(std::move(made));
    logError("Got log generated: %p", static_cast<const void*>(generator));
    if (generator != nullptr) {
        std::string name;
        (void)technology.appendString(name);
        _client.generatorChosen(name);
    }
}

bool ModemLink::sendStartCommand() {
    const auto command = _platform.serialize(_client.generator()->getStartCommand());
    if (!command) {
        logError(" Could not generate PLIST");
        return false;
    }
    const SendError error = send(_sendPort.get(), *command, false).error;
    if (error != SendError::None) {
        logError(" ***** Could not send the START command (got error=%d)",
                 static_cast<std::int32_t>(error));
        return false;
    }
    return true;
}

bool ModemLink::isConnected() const {
    return _recvPort && _sendPort;
}

void ModemLink::refresh() {
    if (isConnected() && !_sendPort->isValid()) {
        _recvPort->invalidate(); // its invalidation callback restarts the link
    }
    _client.displayTick();
}

} // namespace pallax
