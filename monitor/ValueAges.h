#pragma once

#include "monitor/Arrivals.h"
#include "text/Date.h"

#include <chrono>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

class SectionAges;

/// The ages of the values of a display, and which are overdue: a value that has come at each of
/// some ticks is expected at the next ones.
class ValueAges {
public:
    /// Notes what the display has read at a tick. Several arrivals between two ticks count as one.
    void take(const SectionAges& ages);
    void clear() { _arrivals.clear(); }

    /// The arrivals of the node at `path`, or those of the branch above it with which it is read.
    /// Null if it was never read.
    const Arrivals* arrivals(std::string_view path) const;

private:
    std::map<std::string, Arrivals, std::less<>> _arrivals;
};

} // namespace pallax
