#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "platform/MessagePort.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>

namespace pallax {

/// What to do when a record's parser throws.
enum class OnFatalRecord {
    Stop, ///< end with one clear sentence
    Skip, ///< drop the packet, log the sentence, go on
};

/// The effective log code of a message; nothing when it is no log record.
std::optional<LogCode> logCodeOf(Bytes message);

/// "packet 17 (log code 0xFF0000): SIM file data unreadable", or "packet 17 (no log code): …" for
/// what is no log record. Packets are counted from 1.
std::string fatalRecordSentence(std::uint64_t packet, Bytes message, std::string_view reason);

/// A record has ended the program; the text is the sentence.
class FatalRecord : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// Message ports whose receive callbacks may throw: counts the packets (messages of identifier
/// 0, over all local ports) where the source does not number them, and turns an exception into
/// FatalRecord, which leaves through whoever runs the main queue, or with Skip into a line of the
/// system log. It outlives its ports.
class GuardedMessagePorts final : public MessagePorts {
public:
    /// The number of the packet being delivered as its source counts, or 0.
    using PacketNumber = std::function<std::uint32_t()>;

    GuardedMessagePorts(MessagePorts& ports, OnFatalRecord onFatalRecord,
                        PacketNumber packetNumber = {})
        : _ports(ports), _onFatalRecord(onFatalRecord), _packetNumber(std::move(packetNumber)) {}

    Local createLocal(std::string_view name, ReceiveCallback receive) override;
    std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) override {
        return _ports.createRemote(name);
    }

private:
    void failed(std::uint64_t packet, Bytes data, std::string_view reason) const;

    MessagePorts& _ports;
    OnFatalRecord _onFatalRecord;
    PacketNumber _packetNumber;
    std::uint64_t _packets = 0;
};

} // namespace pallax
