#pragma once

#include "text/Date.h"

#include <chrono>

namespace pallax {

/// The current time and the local time zone. For a recording that is being played, the recording's
/// time.
class Clock {
public:
    struct Zone {
        std::chrono::seconds offset{0}; ///< local time minus UTC
        bool daylightSaving = false;
    };

    virtual ~Clock() = default;
    virtual Time now() const = 0;
    /// The zone in force at `time`.
    virtual Zone zone(Time time) const = 0;
};

} // namespace pallax
