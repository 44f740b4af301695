#pragma once

#include "monitor/Frame.h"
#include "monitor/TickGrid.h"
#include "timeline/Timeline.h"

#include <optional>

namespace pallax {

/// The frame of a display tick that was made again.
struct TickFrame {
    FrameRef frame;
    FrameRef before;       ///< of the tick before, which tells the changes; null at the first
    TickGrid::Tick tick;   ///< as `decode --every tick` numbers it
    std::uint64_t instant; ///< the last packet before the tick
};

/// The frame of the latest tick with new data at or before a time, in the first stretch that has
/// that time; the tick after the last packet of a stretch counts. Nothing before the first tick. A
/// value that the tick before shows, too, has changed there at the latest: how long before it is
/// not worked out.
std::optional<TickFrame> frameAt(Timeline& timeline, Time time);

/// The frame at a time after the packets that were decoded; `before` may be null.
FrameRef frameOf(Replay& replay, Time time, const FrameRef& before);

/// The time of an instant: the stamp of its packet, or that of the first packet before it. Nothing
/// if the journal does not have it.
std::optional<Time> timeOf(Timeline& timeline, std::uint64_t instant);
/// The instant of a time in the stretch of another instant, limited to that stretch; one beyond its
/// first or last time is in the stretch next to it, if there is one.
std::uint64_t instantBeside(Timeline& timeline, std::uint64_t instant, Time time);

/// The latest tick with new data whose packets are all before an instant, or the earliest one that
/// has packets after it. Nothing if there is none; the ticks before the earliest instant are gone.
std::optional<ShownTick> tickBefore(Timeline& timeline, std::uint64_t instant);
std::optional<ShownTick> tickAfter(Timeline& timeline, std::uint64_t instant);

/// The ticks with new data around a time, as `frameAt` finds them: the one before, if any, and the
/// tick itself. Empty before the first tick.
std::vector<ShownTick> ticksAt(Timeline& timeline, Time time);

} // namespace pallax
