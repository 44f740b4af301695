#pragma once

#include "query/TickWalk.h"
#include "report/ReportBuilder.h"

#include <cstdint>
#include <functional>

namespace pallax {

class Timeline;

/// The first packet of the stretch of time that a packet is in, for `ReportTick`.
std::uint64_t firstPacketAround(const Timeline& timeline, std::uint64_t packet);

/// Gives the ticks of a timeline to a builder: those for which `isWanted` is true. The last one
/// still has to be finished.
void gatherTicks(Timeline& timeline, ReportBuilder& report,
                 const std::function<bool(const TickWalk::State& state)>& isWanted);

} // namespace pallax
