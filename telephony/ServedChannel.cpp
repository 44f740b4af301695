#include "telephony/ServedChannel.h"

#include "host/SocketMessagePorts.h"
#include "platform/TelephonyConstants.h"
#include "telephony/ControlMessages.h"

#include <cerrno>

namespace pallax {

int ServedChannel::open(Setup setup, std::unique_ptr<ServedChannel>& channel) {
    auto sink = SocketSink::connect(setup.queue, setup.ports.directory(), setup.receiverPortName,
                                    std::move(setup.closed));
    if (sink == nullptr) {
        return ECONNREFUSED;
    }
    std::unique_ptr<ServedChannel> made(
        new ServedChannel(std::move(setup.source), std::move(sink)));
    made->_player = std::make_unique<PacketPlayer>(PacketPlayer::Setup{
        setup.queue, *made->_source, *made->_sink, setup.options, std::move(setup.ended)});
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

ServedChannel::ServedChannel(std::unique_ptr<PacketSource> source, std::unique_ptr<SocketSink> sink)
    : _source(std::move(source)), _sink(std::move(sink)) {}

ServedChannel::~ServedChannel() = default;

/// What is no request of ours gets no reply, as a modem would not give any.
std::optional<ByteBuffer> ServedChannel::answer(Bytes request) {
    const auto message = decodeMessage(request);
    if (!message) {
        return std::nullopt;
    }
    const std::string technology = _source->technology();
    if (stringIn(*message, "GetTechnology") == "GetTechnology") {
        return encodeMessage({{"GetTechnology", technology}});
    }
    const bool everything = technology == kHXLogChannelTechnology_IFX;
    if (auto filter = CodeFilter::fromStartCommand(*message, everything)) {
        _player->play(std::move(*filter));
    }
    return std::nullopt;
}

} // namespace pallax
