#pragma once

#include "query/TickWalk.h"
#include "report/ReportBuilder.h"

#include <functional>

namespace pallax {

class Timeline;

/// Gives the ticks of a timeline to a builder: those for which `isWanted` is true. The last one
/// still has to be finished.
void gatherTicks(Timeline& timeline, ReportBuilder& report,
                 const std::function<bool(const TickWalk::State& state)>& isWanted);

} // namespace pallax
