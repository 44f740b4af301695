#include "telephony/ServedChannel.h"

#include "host/Snapshot.h"
#include "host/SocketMessagePorts.h"
#include "platform/TelephonyConstants.h"
#include "telephony/ControlMessages.h"
#include "text/Format.h"

#include <cerrno>

namespace pallax {

namespace {

std::string lossSentence(const std::string& receiver, std::uint64_t count) {
    return count == 0
               ? formatText("%@ is too slow: packets are dropped.", {receiver})
               : formatText("%@ has caught up: %llu packets were dropped.", {receiver, count});
}

} // namespace

int ServedChannel::open(Setup setup, std::unique_ptr<ServedChannel>& channel) {
    const auto lost = [report = setup.report,
                       receiver = setup.receiverPortName](std::uint64_t count) {
        if (report) {
            report(lossSentence(receiver, count));
        }
    };
    auto sink = SocketSink::connect({setup.queue, setup.mostWaiting, std::move(setup.closed), lost},
                                    setup.ports.directory(), setup.receiverPortName);
    if (sink == nullptr) {
        return ECONNREFUSED;
    }
    std::unique_ptr<ServedChannel> made(
        new ServedChannel(std::move(setup.source), std::move(sink), setup.receiverPortName));
    made->_player = std::make_unique<PacketPlayer>(PacketPlayer::Setup{
        setup.queue, *made->_source, *made->_sink, setup.options,
        [self = made.get(), ended = std::move(setup.ended)](const std::string& failure) {
            self->_isStreaming = false;
            self->_hasEnded = true;
            ended(failure);
        },
        std::chrono::steady_clock::now, std::move(setup.technologyChanged)});
    auto local = setup.ports.createLocal(
        setup.portName, [self = made.get()](std::int32_t /*identifier*/, Bytes data) {
            return self->answer(data);
        });
    if (local.port == nullptr || local.alreadyExisted) {
        return EADDRINUSE;
    }
    local.port->setDispatchQueue(setup.queue);
    made->_port = std::move(local.port);
    channel = std::move(made);
    return 0;
}

ServedChannel::ServedChannel(std::unique_ptr<PacketSource> source, std::unique_ptr<SocketSink> sink,
                             std::string receiverPortName)
    : _source(std::move(source)), _sink(std::move(sink)),
      _receiverPortName(std::move(receiverPortName)) {}

ServedChannel::~ServedChannel() = default;

/// Unknown requests get no reply, as from a modem.
std::optional<ByteBuffer> ServedChannel::answer(Bytes request) {
    const auto message = decodeMessage(request);
    if (!message) {
        return std::nullopt;
    }
    const std::string technology = _source->technology();
    if (stringIn(*message, "GetTechnology") == "GetTechnology") {
        return encodeMessage({{"GetTechnology", technology}});
    }
    const bool everything =
        technology == kHXLogChannelTechnology_IFX || technology == kSnapshotTechnology.identifier;
    if (auto filter = CodeFilter::fromStartCommand(*message, everything)) {
        _hasStarted = true;
        _isStreaming = !_hasEnded;
        _player->play(std::move(*filter));
    }
    return std::nullopt;
}

ServiceStatus::Client ServedChannel::status() const {
    return {_receiverPortName, _isStreaming, static_cast<std::int64_t>(_sink->sent()),
            static_cast<std::int64_t>(_sink->dropped())};
}

} // namespace pallax
