#pragma once

#include "text/Bytes.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string_view>

namespace pallax {

class MainQueue;

/// One end of a message connection.
class MessagePort {
public:
    /// Receives the port, which it may destroy: an implementation must not touch the port after the
    /// call.
    using InvalidationCallback = std::function<void(MessagePort&)>;

    virtual ~MessagePort() = default;
    /// An empty callback clears it.
    virtual void setInvalidationCallback(InvalidationCallback callback) = 0;
    /// Ends the port and calls the invalidation callback before it returns. Does nothing on a port
    /// that has already ended.
    virtual void invalidate() = 0;
    virtual bool isValid() const = 0;
};

/// A named port on which messages arrive.
class LocalMessagePort : public MessagePort {
public:
    /// Messages are delivered as blocks of this queue, and not before this call.
    virtual void setDispatchQueue(MainQueue& queue) = 0;
};

/// Why a request was not sent or not answered; the numbers appear in log lines.
enum class SendError : std::int32_t {
    None = 0,
    SendTimedOut = 1,
    ReplyTimedOut = 2,
    InvalidPort = 3, ///< the peer has gone, or the port was invalidated
    TooLarge = 4,    ///< larger than ports carry
};

/// A port opened by name, to which requests are sent.
class RemoteMessagePort : public MessagePort {
public:
    struct Request {
        std::int32_t identifier = 0;
        Bytes data;
        std::chrono::nanoseconds sendTimeout{0};
        std::chrono::nanoseconds replyTimeout{0};
        bool awaitReply = false;
    };
    struct Outcome {
        SendError error = SendError::None;
        std::optional<ByteBuffer> reply; ///< may be missing even without an error
    };
    /// Blocks until the request is sent and, if a reply is wanted, answered, or until a timeout.
    virtual Outcome sendRequest(const Request& request) = 0;
};

/// The registry of named ports.
class MessagePorts {
public:
    /// Receives message identifier and data; a result is sent back as the reply. It may destroy the
    /// port.
    using ReceiveCallback =
        std::function<std::optional<ByteBuffer>(std::int32_t identifier, Bytes data)>;

    struct Local {
        std::unique_ptr<LocalMessagePort> port; ///< null if the port could not be created
        bool alreadyExisted = false;            ///< a living port of that name; `port` is inert
    };

    virtual ~MessagePorts() = default;
    virtual Local createLocal(std::string_view name, ReceiveCallback receive) = 0;
    /// Null if no living port has this name.
    virtual std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) = 0;
};

} // namespace pallax
