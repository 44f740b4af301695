#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "platform/MessagePort.h"

#include <cstdint>
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

/// "packet 17 (log code 0xFF0000): SIM file data unreadable". Packets are counted from 1.
std::string fatalRecordSentence(std::uint64_t packet, Bytes message, std::string_view reason);

/// A record has ended the program; the text is the sentence.
class FatalRecord : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// Message ports whose receive callbacks may throw: counts the packets (messages of identifier
/// 0, over all local ports) and turns an exception into FatalRecord, which leaves through
/// whoever runs the main queue, or with Skip into a line of the system log. It outlives its ports.
class GuardedMessagePorts final : public MessagePorts {
public:
    GuardedMessagePorts(MessagePorts& ports, OnFatalRecord onFatalRecord)
        : _ports(ports), _onFatalRecord(onFatalRecord) {}

    Local createLocal(std::string_view name, ReceiveCallback receive) override;
    std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) override {
        return _ports.createRemote(name);
    }

private:
    void failed(std::uint64_t packet, Bytes data, std::string_view reason) const;

    MessagePorts& _ports;
    OnFatalRecord _onFatalRecord;
    std::uint64_t _packets = 0;
};

} // namespace pallax
