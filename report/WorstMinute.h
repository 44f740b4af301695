#pragma once

#include "text/Date.h"

#include <cstdint>
#include <deque>
#include <optional>

namespace pallax {

/// Finds the minute in which a number was worst on average, weighted by how long it had each value.
class WorstMinute {
public:
    struct Found {
        Time from;
        Time to;
        double mean;
        std::uint32_t stretch; ///< its place among the report's stretches of time
    };

    explicit WorstMinute(bool isSmallerBetter = false) : _isSmallerBetter(isSmallerBetter) {}

    /// A value from a time on, which must not be before the earlier ones unless `restart` was
    /// called.
    void add(Time from, double seconds, double value, std::uint32_t stretch);
    /// The clock has stepped: the next minute begins anew.
    void restart() { _held.clear(), _seconds = 0, _sum = 0; }

    /// Nothing before a whole minute, of which most was known.
    const std::optional<Found>& found() const { return _found; }

private:
    struct Held {
        Time from;
        double seconds;
        double value;
    };

    bool _isSmallerBetter;
    std::deque<Held> _held;
    double _seconds = 0;
    double _sum = 0;
    std::optional<Found> _found;
};

} // namespace pallax
