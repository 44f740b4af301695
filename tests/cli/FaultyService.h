#pragma once

#include <string>
#include <sys/types.h>

namespace pallax::doubles {

/// The service's only fault; afterwards it works, unless the fault ends it.
enum class Fault {
    None,
    KilledBeforeTheConnection,
    KilledAtTheChannelRequest,
    KilledAfterTheChannel,
    KilledBeforeTheReply,
    KilledAfterTheReply,
    KilledAtTheStartCommand,
    KilledWhileStreaming,
    ChannelClosedWhileLive, ///< keeps streaming live, with stamps that do not advance
    ReplyTooLate,
    ReplyIsNoPropertyList,
    ReplyWithoutTheKey,
    UnknownTechnology,
};

/// A telephony service of the GSM technology in its own process, with a fault that no real service
/// should have. It streams a registration record for each second, as fast as it is read. The socket
/// folder is $XDG_RUNTIME_DIR.
class FaultyService {
public:
    /// Returns when clients can connect or, for that fault, when the service was killed.
    explicit FaultyService(Fault fault);
    /// Kills it.
    ~FaultyService();
    FaultyService(const FaultyService&) = delete;
    FaultyService& operator=(const FaultyService&) = delete;

    /// True after it has ended by itself.
    bool hasEnded();

private:
    pid_t _process = -1;
};

} // namespace pallax::doubles
