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

/// What to do when a record throws.
enum class OnFatalRecord {
    Stop, ///< exit with one sentence
    Skip, ///< drop the packet, log the sentence, continue
};

/// The effective log code of a message; nothing if it is not a log record.
std::optional<LogCode> logCodeOf(Bytes message);

/// "packet 17 (log code 0xFF0000): SIM file data unreadable", or "packet 17 (no log code): …" for a
/// message that is not a log record. Packets are counted from 1.
std::string fatalRecordSentence(std::uint64_t packet, Bytes message, std::string_view reason);

/// A fatal record has ended the program; the text is the sentence.
class FatalRecord : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// Message ports whose receive callbacks may throw. Counts the packets (messages of identifier 0,
/// over all local ports) if the source does not number them, and turns an exception into
/// FatalRecord, which propagates to the caller that runs the main queue, or with Skip into a line
/// of the system log. Must outlive its ports.
class GuardedMessagePorts final : public MessagePorts {
public:
    /// The number of the current packet in its source, or 0.
    using PacketNumber = std::function<std::uint32_t()>;

    /// `modem` begins the sentences, unless it is empty.
    GuardedMessagePorts(MessagePorts& ports, OnFatalRecord onFatalRecord,
                        PacketNumber packetNumber = {}, std::string modem = {})
        : _ports(ports), _onFatalRecord(onFatalRecord), _packetNumber(std::move(packetNumber)),
          _modem(std::move(modem)) {}

    Local createLocal(std::string_view name, ReceiveCallback receive) override;
    std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) override {
        return _ports.createRemote(name);
    }

private:
    void failed(std::uint64_t packet, Bytes data, std::string_view reason) const;

    MessagePorts& _ports;
    OnFatalRecord _onFatalRecord;
    PacketNumber _packetNumber;
    std::string _modem;
    std::uint64_t _packets = 0;
};

} // namespace pallax
