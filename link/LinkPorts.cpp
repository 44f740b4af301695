#include "link/LinkPorts.h"

#include "telephony/ControlMessages.h"
#include "telephony/NamedServices.h"
#include "text/Format.h"

#include <cerrno>
#include <cstring>
#include <utility>

namespace pallax {

namespace {

constexpr std::int32_t kPacketMessage = 0;

constexpr const char* kNoAnswer = "The telephony service does not answer";
constexpr const char* kBusy = "The telephony service is busy with other clients";
constexpr const char* kNothingToPlay = "The telephony service has nothing to play to this client";
constexpr const char* kRefused = "The telephony service refuses a log channel";
constexpr const char* kNoTechnology = "The modem's technology is unknown";

/// Why a request for a log channel failed.
std::string refusal(const LogChannel& channel) {
    if (channel.errorDomain == kPortErrorDomain) {
        return kNoAnswer;
    }
    switch (channel.errorCode) {
    case EMFILE:
        return kBusy;
    case EIO:
        return kNothingToPlay;
    default:
        return formatText(
            "%@: %@",
            {kRefused, std::strerror(channel.errorCode)}); // NOLINT(concurrency-mt-unsafe)
    }
}

std::string withoutFullStop(std::string sentence) {
    if (sentence.ends_with('.')) {
        sentence.pop_back();
    }
    return sentence;
}

} // namespace

/// Requests the log channel for the real local port.
class LinkPorts::Connection final : public HXServerConnection {
public:
    Connection(std::unique_ptr<HXServerConnection> connection, LinkPorts& link)
        : _connection(std::move(connection)), _link(link) {}

    LogChannel
    HXServerConnectionNetworkMonitorCreateLogChannel(std::string_view /*localPortName*/) override {
        LogChannel channel =
            _connection->HXServerConnectionNetworkMonitorCreateLogChannel(_link._localName);
        if (channel.errorCode != 0) {
            _link._obstacle = refusal(channel);
        }
        return channel;
    }

private:
    std::unique_ptr<HXServerConnection> _connection;
    LinkPorts& _link;
};

LinkPorts::LinkPorts(Setup setup)
    : _setup(std::move(setup)), _noService(noServiceText(_setup.serviceName)) {}

MessagePorts::Local LinkPorts::createLocal(std::string_view name, ReceiveCallback callback) {
    ReceiveCallback receive = [this, callback = std::move(callback)](std::int32_t identifier,
                                                                     Bytes data) {
        ++_received;
        if (identifier != kPacketMessage) {
            return callback(identifier, data);
        }
        const ByteBuffer filtered = _filter ? _filter(data) : ByteBuffer();
        const Bytes delivered = _filter ? Bytes(filtered) : data;
        if (_tap) {
            _tap(delivered);
        }
        return callback(identifier, delivered);
    };
    _localName = name;
    Local local = _setup.ports.createLocal(_localName, receive);
    if (local.alreadyExisted) {
        _localName = _setup.ownLocalName;
        local = _setup.ports.createLocal(_localName, std::move(receive));
    }
    if (local.port == nullptr) {
        _obstacle = withoutFullStop(_setup.whyNoPort());
    } else if (local.alreadyExisted) {
        _obstacle = formatText("The message port %@ exists already", {_localName});
    }
    return local;
}

std::string_view LinkPorts::briefObstacle() const {
    if (_obstacle == _noService) {
        return "no service";
    }
    constexpr std::pair<std::string_view, std::string_view> kBrief[] = {
        {"", ""},
        {kNoAnswer, "no answer"},
        {kBusy, "service is busy"},
        {kNothingToPlay, "nothing to play"},
        {kNoTechnology, "unknown technology"},
    };
    for (const auto& [sentence, brief] : kBrief) {
        if (_obstacle == sentence) {
            return brief;
        }
    }
    return _obstacle.starts_with(kRefused) ? "service refuses" : "no message port";
}

std::unique_ptr<HXServerConnection> LinkPorts::connect(std::function<void()> notification) {
    auto connection = _setup.telephony.connect(std::move(notification));
    if (connection == nullptr) {
        _obstacle = _setup.isServiceThere() ? kNoAnswer : _noService;
        return nullptr;
    }
    _obstacle = kNoAnswer;
    return std::make_unique<Connection>(std::move(connection), *this);
}

std::unique_ptr<RemoteMessagePort> LinkPorts::createRemote(std::string_view name) {
    auto port = _setup.ports.createRemote(name);
    _obstacle = port != nullptr ? kNoTechnology : kNoAnswer;
    return port;
}

} // namespace pallax
