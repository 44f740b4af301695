#pragma once

#include "platform/Clock.h"

#include <chrono>

namespace pallax {

/// A clock for durations: its start is arbitrary, and it never goes back.
class MonotonicClock final : public Clock {
public:
    Time now() const override { return Time(std::chrono::steady_clock::now().time_since_epoch()); }
    Zone zone(Time /*time*/) const override { return {}; }
};

} // namespace pallax
