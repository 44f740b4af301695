#pragma once

#include "host/SourceTimeListener.h"
#include "platform/Clock.h"
#include "platform/RepeatingTimer.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <list>
#include <memory>
#include <optional>

namespace pallax {

/// The clock and the timers of whoever watches a source that tells its own time: while a
/// recording is played, display ticks fall where the recording's time puts them, whatever the
/// machine's load or the speed of playing, so the same recording gives the same ticks.
///
/// A timer's ticks lie on a grid: the first source time of the connection plus whole intervals.
/// Before the clock reaches a time it does the ticks up to and including it, each timer at most
/// once for its earliest tick; ticks that a gap leaves behind are left out. During a tick `now`
/// is the tick's own time. While no source time has been heard for kSilence, the timers fire by
/// the wall clock instead.
class SourceClock final : public Clock, public TimerScheduler, public SourceTimeListener {
public:
    static constexpr std::chrono::seconds kSilence{2};
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    /// Both outlive the clock. `steadyNow` tells how long the source has been silent.
    SourceClock(const Clock& wallClock, TimerScheduler& wallTimers,
                SteadyNow steadyNow = std::chrono::steady_clock::now);
    ~SourceClock() override;
    SourceClock(const SourceClock&) = delete;
    SourceClock& operator=(const SourceClock&) = delete;

    /// Called when a source ends; an empty callback clears it.
    void onEnd(std::function<void()> callback) { _ended = std::move(callback); }

    /// The time that the source's clock has reached; the wall clock's before there is any.
    Time now() const override;
    Zone zone(Time time) const override;
    std::unique_ptr<RepeatingTimer> scheduleRepeating(std::chrono::nanoseconds interval,
                                                      std::function<void()> action) override;

    void sourceBegan() override;
    bool advance(Time time) override;
    void packetNumber(std::uint32_t number) override { _packetNumber = number; }
    void sourceEnded() override;

    /// The number of the latest packet in its source, counted from 1; 0 when it is not told.
    std::uint32_t packetNumber() const { return _packetNumber; }

private:
    class Timer;
    struct TimerState;

    bool isSilent() const;

    const Clock& _wallClock;
    TimerScheduler& _wallTimers;
    SteadyNow _steadyNow;
    std::function<void()> _ended;
    std::optional<Time> _first; ///< of this connection
    std::optional<Time> _now;
    std::uint32_t _packetNumber = 0;
    std::optional<std::chrono::steady_clock::time_point> _heard;
    std::list<std::weak_ptr<TimerState>> _timers; ///< in the order of their scheduling
};

} // namespace pallax
