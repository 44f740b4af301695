#include "cli/FatalRecord.h"

#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr std::uint8_t kPrefixMark = 0x81; // a prefix of two bytes, the second of no meaning
constexpr std::size_t kPrefixLength = 2;
constexpr std::size_t kHeaderLength = 13;
constexpr std::uint8_t kStandardType = 1;
constexpr std::uint8_t kExtendedType = 0xFF;
constexpr std::size_t kCodeOffset = 3; // two bytes, little-endian
constexpr std::uint32_t kExtendedCodes = 0xFF0000;

} // namespace

std::optional<std::uint32_t> logCodeOf(Bytes message) {
    Bytes record = message;
    if (record.size() > kPrefixLength && record[0] == kPrefixMark) {
        record = record.subspan(kPrefixLength);
    }
    if (record.size() < kHeaderLength ||
        (record[0] != kStandardType && record[0] != kExtendedType)) {
        return std::nullopt;
    }
    const std::uint32_t code = record[kCodeOffset] | std::uint32_t{record[kCodeOffset + 1]} << 8U;
    return record[0] == kExtendedType ? kExtendedCodes | code : code;
}

std::string fatalRecordSentence(std::uint64_t packet, Bytes message, std::string_view reason) {
    const auto code = logCodeOf(message);
    const std::string where = code ? formatText(" (log code 0x%04X)", {*code}) : "";
    return formatText("packet %llu%@: %@", {packet, where, reason});
}

MessagePorts::Local GuardedMessagePorts::createLocal(std::string_view name,
                                                     ReceiveCallback receive) {
    auto guarded = [this, receive = std::move(receive)](std::int32_t identifier,
                                                        Bytes data) -> std::optional<ByteBuffer> {
        // The callback may destroy the port, and with it this closure: nothing of it is touched
        // once the callback has been called.
        GuardedMessagePorts* const self = this;
        const std::uint64_t packet = identifier == 0 ? ++_packets : _packets;
        try {
            return receive(identifier, data);
        } catch (const std::exception& error) {
            self->failed(packet, data, error.what());
            return std::nullopt;
        }
    };
    return _ports.createLocal(name, std::move(guarded));
}

void GuardedMessagePorts::failed(std::uint64_t packet, Bytes data, std::string_view reason) const {
    const std::string sentence = fatalRecordSentence(packet, data, reason);
    if (_onFatalRecord == OnFatalRecord::Stop) {
        throw FatalRecord(sentence);
    }
    systemLog(LogPriority::Error, "%@", sentence);
}

} // namespace pallax
