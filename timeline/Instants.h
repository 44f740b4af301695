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

/// The ticks with new data around a time, as `frameAt` finds them: the one before, if any, and the
/// tick itself. Empty before the first tick.
std::vector<ShownTick> ticksAt(Timeline& timeline, Time time);

} // namespace pallax
