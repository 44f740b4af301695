#pragma once

#include "host/SourceTimeListener.h"
#include "packets/StampSequence.h"
#include "platform/Clock.h"
#include "platform/RepeatingTimer.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <list>
#include <memory>
#include <optional>

namespace pallax {

/// The clock and the timers of a program that watches a source.
///
/// A played source (a recording, a simulation) sets the time: its stamps determine the display
/// ticks, so the same recording gives the same ticks at any load and playing speed. A
/// timer's ticks lie on a grid: the first source time plus whole intervals. Before the clock
/// reaches a time, it runs the ticks up to and including it, each timer at most once, for its
/// earliest tick; it skips the other ticks of a gap. During a tick, `now` is the tick's time. When
/// the stamps step back (StampSequence), each timer runs its next tick and gets a grid that starts
/// there. If the source is silent for kSilence, the timers follow the wall clock, and the clock
/// advances until the source continues or ends.
///
/// For a live source, clock and timers are the wall clock's; its stamps are only available through
/// `stamp`.
class SourceClock final : public Clock, public TimerScheduler, public SourceTimeListener {
public:
    static constexpr std::chrono::seconds kSilence{2};
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;
    using RemarkCallback = std::function<void(std::uint32_t packet, const StampRemark& remark)>;

    /// Both must outlive the clock. `steadyNow` measures how long the source has been silent.
    SourceClock(const Clock& wallClock, TimerScheduler& wallTimers,
                SteadyNow steadyNow = std::chrono::steady_clock::now);
    ~SourceClock() override;
    SourceClock(const SourceClock&) = delete;
    SourceClock& operator=(const SourceClock&) = delete;

    /// Called when a source ends; an empty callback clears it.
    void onEnd(std::function<void()> callback) { _ended = std::move(callback); }
    /// Called for a packet with an odd stamp.
    void onStampRemark(RemarkCallback callback) { _remarked = std::move(callback); }

    /// The current time of a played source; before its first, and for a live source, the wall
    /// clock's.
    Time now() const override;
    Zone zone(Time time) const override;
    std::unique_ptr<RepeatingTimer> scheduleRepeating(std::chrono::nanoseconds interval,
                                                      std::function<void()> action) override;

    void sourceBegan(bool isLive) override;
    bool advance(Time time) override;
    void packetNumber(std::uint32_t number) override { _packetNumber = number; }
    void stampRemark(std::uint32_t packet, const StampRemark& remark) override;
    void sourceEnded() override;

    /// Whether the present source is a live one.
    bool isLive() const { return _isLive; }
    /// The number of the latest packet in its source, counted from 1; 0 if unknown.
    std::uint32_t packetNumber() const { return _packetNumber; }
    /// The latest source time as received, which for a packet is its stamp; `now` before the first.
    Time stamp() const { return _stamp ? *_stamp : now(); }

private:
    class Timer;
    struct TimerState;

    std::chrono::nanoseconds silence() const;
    bool firesByTheWall() const;
    std::optional<Time> nextTick(std::chrono::nanoseconds interval) const;
    std::shared_ptr<TimerState> earliestTimer(Time latest) const;
    void beginStretch(Time time);

    const Clock& _wallClock;
    TimerScheduler& _wallTimers;
    SteadyNow _steadyNow;
    std::function<void()> _ended;
    RemarkCallback _remarked;
    bool _isLive = false;
    bool _hasEnded = false;
    StampSequence _times;      ///< of this connection
    bool _stretchEnds = false; ///< the timers run their last ticks
    std::optional<Time> _now;
    std::optional<Time> _stamp;
    std::uint32_t _packetNumber = 0;
    std::optional<std::chrono::steady_clock::time_point> _heard;
    std::list<std::weak_ptr<TimerState>> _timers; ///< in the order in which they were scheduled
};

} // namespace pallax
