#include "decoding/FatalRecord.h"

#include "LogGenerator/LogPacket.h"
#include "decoding/RequiredTemplates.h"
#include "platform/SystemLog.h"

namespace pallax {

std::optional<LogCode> logCodeOf(Bytes message) {
    const LogRecord record(LogPacketRecord(message));
    const std::uint8_t type = record.u8(0);
    if (!record.has(LogRecord::kHeaderLength) ||
        (type != LogRecord::kStandardType && type != LogRecord::kExtendedType)) {
        return std::nullopt;
    }
    return LogPacketGetLogCode(record);
}

std::string fatalRecordSentence(std::uint64_t packet, Bytes message, std::string_view reason) {
    const auto code = logCodeOf(message);
    const std::string where = code ? formatText("log code 0x%04X", {*code}) : "no log code";
    return formatText("packet %llu (%@): %@", {packet, where, reason});
}

MessagePorts::Local GuardedMessagePorts::createLocal(std::string_view name,
                                                     ReceiveCallback receive) {
    auto guarded = [this, receive = std::move(receive)](std::int32_t identifier,
                                                        Bytes data) -> std::optional<ByteBuffer> {
        // The callback may destroy the port, and with it this closure: use nothing of it after the
        // call.
        GuardedMessagePorts* const self = this;
        const std::uint64_t counted = identifier == 0 ? ++_packets : _packets;
        const std::uint32_t told = _packetNumber ? _packetNumber() : 0;
        const std::uint64_t packet = told != 0 ? told : counted;
        try {
            return receive(identifier, data);
        } catch (const TemplateFailure&) {
            throw;
        } catch (const std::exception& error) {
            self->failed(packet, data, error.what());
            return std::nullopt;
        }
    };
    return _ports.createLocal(name, std::move(guarded));
}

void GuardedMessagePorts::failed(std::uint64_t packet, Bytes data, std::string_view reason) const {
    const std::string sentence =
        (_modem.empty() ? "" : _modem + ": ") + fatalRecordSentence(packet, data, reason);
    if (_onFatalRecord == OnFatalRecord::Stop) {
        throw FatalRecord(sentence);
    }
    systemLog(LogPriority::Error, "%@", sentence);
}

} // namespace pallax
