#pragma once

#include "packets/StampSequence.h"
#include "text/Date.h"

#include <cstdint>

namespace pallax {

/// Receives the source times that arrive on a local port, in order.
class SourceTimeListener {
public:
    virtual ~SourceTimeListener() = default;
    /// A new connection starts to send times; they may be earlier than the previous ones. The times
    /// of a live source are its stamps and do not affect the present.
    virtual void sourceBegan(bool isLive) = 0;
    /// One step towards `time`. True: a tick before `time` was due and has run; blocks that it
    /// posted on the main queue come first, then call this again from a later block. False: the
    /// clock is at `time`.
    virtual bool advance(Time time) = 0;
    /// The next message is the packet with this number in its source, counted from 1; 0 if unknown.
    virtual void packetNumber(std::uint32_t number) = 0;
    /// The stamp of the packet with this number is odd; listeners may just report it.
    virtual void stampRemark(std::uint32_t packet, const StampRemark& remark) = 0;
    /// The source has ended.
    virtual void sourceEnded() = 0;
};

} // namespace pallax
