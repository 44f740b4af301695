#pragma once

#include "report/HeldSeries.h"
#include "text/Date.h"

#include <cstddef>
#include <limits>
#include <span>
#include <string>
#include <vector>

namespace pallax {

/// The part of some series that a chart draws.
struct SeriesRange {
    Time from;
    Time to;
    std::size_t points = 0; ///< about so many instants at most
    /// The places of the first tick, and of that after the last one: where the clock was set back,
    /// a time alone does not tell.
    std::size_t first = 0;
    std::size_t end = std::numeric_limits<std::size_t>::max();
};

/// {"times":[seconds …],"values":[[number or null …] …]}: each series at the ticks of the range or,
/// if there are more than points, the least and the greatest value of runs of ticks, so that no
/// peak is lost. Where time is missing, there is an instant without values. Times ascend: ticks
/// after a clock that was set back, which are not later than one before, are left out.
std::string seriesJson(const std::vector<Time>& ticks, std::span<const HeldSeries* const> series,
                       const SeriesRange& range);

} // namespace pallax
