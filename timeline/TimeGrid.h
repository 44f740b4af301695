#pragma once

#include "text/Date.h"

#include <chrono>
#include <cstdint>

namespace pallax {

/// The moments that lie whole intervals after a first one: moment n (from 1) is n intervals later.
/// All is reckoned, nothing is stepped, and over the whole range of Time nothing overflows: a
/// moment that Time cannot hold is Time::max().
class TimeGrid {
public:
    /// `interval` is positive.
    TimeGrid(Time first, std::chrono::nanoseconds interval) : _first(first), _interval(interval) {}

    /// How many moments lie at or before `time`.
    std::uint64_t passedAt(Time time) const;
    Time moment(std::uint64_t number) const;
    /// The first moment after `time`.
    Time nextAfter(Time time) const { return moment(passedAt(time) + 1); }

private:
    Time _first;
    std::chrono::nanoseconds _interval;
};

} // namespace pallax
