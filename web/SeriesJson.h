#pragma once

#include "report/HeldSeries.h"
#include "text/Date.h"

#include <cstddef>
#include <span>
#include <string>
#include <vector>

namespace pallax {

/// The part of some series that a chart draws.
struct SeriesRange {
    Time from;
    Time to;
    std::size_t points = 0; ///< about so many instants at most
};

/// {"times":[seconds …],"values":[[number or null …] …]}: each series at the ticks of the range or,
/// if there are more than points, the least and the greatest value of runs of ticks, so that no
/// peak is lost. Times ascend: ticks after a clock that was set back, which are not later than one
/// before, are left out.
std::string seriesJson(const std::vector<Time>& ticks, std::span<const HeldSeries* const> series,
                       const SeriesRange& range);

} // namespace pallax
