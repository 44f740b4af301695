#include "telephony/TelephonyServer.h"

#include "host/AsioMainQueue.h"
#include "host/SocketMessagePorts.h"
#include "platform/RepeatingTimer.h"
#include "telephony/ServedChannel.h"
#include "text/Format.h"

#include <algorithm>
#include <cerrno>

namespace pallax {

namespace {

constexpr const char* kChannelSuffix = ".LogChannel.";
constexpr std::chrono::seconds kLookInterval{1};

} // namespace

Result<std::unique_ptr<TelephonyServer>, HostError> TelephonyServer::start(Setup setup) {
    std::unique_ptr<TelephonyServer> server(new TelephonyServer(std::move(setup)));
    const Setup& kept = server->_setup;
    auto local = kept.ports.createLocal(
        kept.controlPortName, [self = server.get()](std::int32_t /*identifier*/, Bytes data) {
            return self->answer(data);
        });
    if (local.port == nullptr) {
        return HostError{kept.ports.lastError()};
    }
    if (local.alreadyExisted) {
        const std::string& service = kept.ports.directory().service();
        return HostError{formatText("A telephony service named %@ is already running.",
                                    {service.empty() ? kept.controlPortName : service})};
    }
    local.port->setDispatchQueue(kept.queue);
    server->_control = std::move(local.port);
    TimerScheduler& timers = kept.timers != nullptr ? *kept.timers : kept.queue;
    server->_looks =
        timers.scheduleRepeating(kLookInterval, [self = server.get()] { self->closeIdle(); });
    return server;
}

TelephonyServer::TelephonyServer(Setup setup)
    : _setup(std::move(setup)), _started(_setup.steadyNow()) {}

TelephonyServer::~TelephonyServer() = default;

std::optional<ByteBuffer> TelephonyServer::answer(Bytes request) {
    const auto message = decodeMessage(request);
    if (message && isStatusRequest(*message)) {
        return encodeMessage(statusReply(status()));
    }
    const auto localPort = message ? stringIn(*message, "CreateLogChannel") : std::nullopt;
    const LogChannel channel =
        localPort ? createLogChannel(*localPort) : LogChannel{kServiceErrorDomain, EINVAL, {}};
    return encodeMessage(createLogChannelReply(channel));
}

/// A channel that feeds the service itself would never end.
bool TelephonyServer::isOwnPort(const std::string& name) const {
    return name == _setup.controlPortName ||
           name.starts_with(_setup.controlPortName + kChannelSuffix);
}

LogChannel TelephonyServer::createLogChannel(const std::string& localPortName) {
    if (isOwnPort(localPortName)) {
        return {kServiceErrorDomain, EINVAL, {}};
    }
    if (!makeRoom()) {
        return {kServiceErrorDomain, EMFILE, {}};
    }
    auto source = _setup.makeSource();
    if (!source) {
        report(source.error().sentence);
        return {kServiceErrorDomain, EIO, {}};
    }
    std::string portName;
    do { // an earlier service may still be ending
        portName = formatText("%@%@%d", {_setup.controlPortName, kChannelSuffix, ++_latestNumber});
    } while (_setup.ports.isTaken(portName));
    const auto remove = [this, number = _latestNumber] { removeChannel(number); };
    std::unique_ptr<ServedChannel> channel;
    const int error = ServedChannel::open(
        ServedChannel::Setup{_setup.queue, _setup.ports, portName, localPortName,
                             std::move(source).value(), _setup.options, _setup.mostWaiting,
                             [this](const std::string& sentence) { report(sentence); }, remove,
                             remove,
                             [this](const std::string& failure) {
                                 if (!failure.empty()) {
                                     report(failure);
                                 }
                             }},
        channel);
    if (error != 0) {
        return {kServiceErrorDomain, error, {}};
    }
    _channels.emplace(_latestNumber, Channel{std::move(channel), _setup.steadyNow()});
    return {0, 0, std::move(portName)};
}

void TelephonyServer::removeChannel(int number) {
    const auto found = _channels.find(number);
    if (found == _channels.end()) {
        return;
    }
    const ServiceStatus::Client last = found->second.served->status();
    _sentBefore += last.sent;
    _droppedBefore += last.dropped;
    if (last.dropped > 0) {
        report(formatText("%@ has gone: of its packets %lld were sent and %lld dropped.",
                          {last.localPort, last.sent, last.dropped}));
    }
    _channels.erase(found);
}

void TelephonyServer::closeIdle() {
    const auto latest = _setup.steadyNow() - kMostIdle;
    for (auto each = _channels.begin(); each != _channels.end();) {
        const auto channel = each++;
        if (!channel->second.served->hasStarted() && channel->second.opened <= latest) {
            close(channel);
        }
    }
}

bool TelephonyServer::makeRoom() {
    if (_channels.size() < kMostChannels) {
        return true;
    }
    const auto idle = std::find_if(_channels.begin(), _channels.end(), [](const auto& entry) {
        return !entry.second.served->hasStarted();
    });
    if (idle == _channels.end()) {
        return false;
    }
    close(idle);
    return true;
}

void TelephonyServer::close(Channels::iterator idle) {
    report(formatText("%@ never started its log channel, which is closed now.",
                      {idle->second.served->receiverPortName()}));
    _channels.erase(idle);
}

std::size_t TelephonyServer::untaken() const {
    std::size_t bytes = 0;
    for (const auto& entry : _channels) {
        bytes += entry.second.served->untaken();
    }
    return bytes;
}

ServiceStatus TelephonyServer::status() const {
    const auto uptime =
        std::chrono::duration_cast<std::chrono::seconds>(_setup.steadyNow() - _started);
    ServiceStatus status{_setup.technology, uptime.count(), _sentBefore, _droppedBefore, {}};
    for (const auto& entry : _channels) {
        status.clients.push_back(entry.second.served->status());
        status.sent += status.clients.back().sent;
        status.dropped += status.clients.back().dropped;
    }
    return status;
}

void TelephonyServer::report(const std::string& sentence) const {
    if (_setup.report) {
        _setup.report(sentence);
    }
}

} // namespace pallax
