#pragma once

#include <chrono>
#include <functional>
#include <memory>

namespace pallax {

/// A scheduled repeating timer. `invalidate` or destruction ends it, even inside its own action.
class RepeatingTimer {
public:
    virtual ~RepeatingTimer() = default;
    virtual void invalidate() = 0;
};

/// Schedules repeating timers on the main run loop.
class TimerScheduler {
public:
    virtual ~TimerScheduler() = default;
    virtual std::unique_ptr<RepeatingTimer> scheduleRepeating(std::chrono::nanoseconds interval,
                                                              std::function<void()> action) = 0;
};

} // namespace pallax
