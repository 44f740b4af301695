#pragma once

#include <string>
#include <sys/types.h>

namespace pallax::doubles {

/// What goes wrong with a service, once; after that it serves as it should, if it lives.
enum class Fault {
    None,
    KilledBeforeTheConnection,
    KilledAtTheChannelRequest,
    KilledAfterTheChannel,
    KilledBeforeTheReply,
    KilledAfterTheReply,
    KilledAtTheStartCommand,
    KilledWhileStreaming,
    ChannelClosedWhileLive, ///< streams on, live, and its stamps stand
    ReplyTooLate,
    ReplyIsNoPropertyList,
    ReplyWithoutTheKey,
    UnknownTechnology,
};

/// A telephony service of the GSM technology in a process of its own, which does what no real
/// one should. It streams a registration record with each of its seconds, as fast as it is taken.
/// $XDG_RUNTIME_DIR is the sockets' folder.
class FaultyService {
public:
    /// Returns once clients can connect, or, where that is the fault, once it has been killed.
    explicit FaultyService(Fault fault);
    /// Kills it.
    ~FaultyService();
    FaultyService(const FaultyService&) = delete;
    FaultyService& operator=(const FaultyService&) = delete;

    /// True once it has ended by itself.
    bool hasEnded();

private:
    pid_t _process = -1;
};

} // namespace pallax::doubles
