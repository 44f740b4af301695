#pragma once

#include "text/Date.h"

#include <array>
#include <chrono>
#include <cstddef>
#include <optional>

namespace pallax {

/// The usual time between the arrivals of something, which tells when it is overdue.
class Arrivals {
public:
    /// So many intervals are kept.
    static constexpr std::size_t kKept = 16;
    /// Nothing is overdue before so many arrivals.
    static constexpr std::size_t kLeast = 4;
    static constexpr std::chrono::seconds kLeastPatience{4};

    /// Notes an arrival. The same time again is the same arrival; an earlier one, after a clock was
    /// set back, gives no interval.
    void note(Time time);

    const std::optional<Time>& last() const { return _last; }
    /// The median of the latest intervals; nothing without an interval.
    std::optional<std::chrono::nanoseconds> median() const;
    /// What is older than this is overdue: three times the median, and at least `kLeastPatience`.
    /// Nothing before `kLeast` arrivals.
    std::optional<std::chrono::nanoseconds> patience() const;

private:
    std::array<std::chrono::nanoseconds, kKept> _intervals{};
    std::size_t _next = 0;  ///< the place of the next interval
    std::size_t _count = 0; ///< of intervals since the beginning
    std::optional<Time> _last;
};

} // namespace pallax
