#pragma once

#include "text/Date.h"
#include "timeline/StampSequence.h"

#include <cstdint>

namespace pallax {

/// Hears the source times that arrive on a local port, in order.
class SourceTimeListener {
public:
    virtual ~SourceTimeListener() = default;
    /// A new connection begins to tell the time; its times need not follow the earlier ones. The
    /// times of a live source are its stamps, and whatever they do, the present goes on.
    virtual void sourceBegan(bool isLive) = 0;
    /// One step towards `time`. True: something fell due before it and was done; what that
    /// posted on the main queue comes first, then this is to be called again from a later block.
    /// False: the clock stands at `time`.
    virtual bool advance(Time time) = 0;
    /// The message that is delivered next is that packet of its source, counted from 1; 0 when
    /// the source does not say.
    virtual void packetNumber(std::uint32_t number) = 0;
    /// The stamp of the packet with that number is odd; nothing but a sentence need come of it.
    virtual void stampRemark(std::uint32_t packet, const StampRemark& remark) = 0;
    /// The source has come to its end.
    virtual void sourceEnded() = 0;
};

} // namespace pallax
