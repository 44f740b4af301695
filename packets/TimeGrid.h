#pragma once

#include "text/Date.h"

#include <chrono>
#include <cstdint>

namespace pallax {

/// The times at whole intervals after a first one: number n (from 1) is n intervals later. Each is
/// computed directly, without accumulating. Times beyond the range of Time are Time::max().
class TimeGrid {
public:
    /// `interval` must be positive.
    TimeGrid(Time first, std::chrono::nanoseconds interval) : _first(first), _interval(interval) {}

    /// The number of grid times at or before `time`.
    std::uint64_t passedAt(Time time) const;
    Time moment(std::uint64_t number) const;
    /// The first grid time after `time`.
    Time nextAfter(Time time) const { return moment(passedAt(time) + 1); }

private:
    Time _first;
    std::chrono::nanoseconds _interval;
};

} // namespace pallax
