#pragma once

#include "host/SourceTimeListener.h"
#include "platform/Clock.h"
#include "platform/RepeatingTimer.h"
#include "timeline/StampSequence.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <list>
#include <memory>
#include <optional>

namespace pallax {

/// The clock and the timers of whoever watches a source.
///
/// A source that is played (a recording, a simulation) tells the time: display ticks fall where its
/// stamps put them, whatever the machine's load or the speed of playing, so the same recording
/// gives the same ticks. A timer's ticks lie on a grid: the first source time plus whole intervals.
/// Before the clock reaches a time it does the ticks up to and including it, each timer at most
/// once for its earliest tick; ticks that a gap leaves behind are left out. During a tick `now` is
/// the tick's own time. Where the stamps step back (StampSequence), each timer does its next tick
/// and gets a grid that begins there. While no source time has been heard for kSilence, the timers
/// fire by the wall, and the clock runs on until the source goes on or has ended.
///
/// A live source tells no time: clock and timers are the wall's, and its stamps are for those only
/// who ask for them.
class SourceClock final : public Clock, public TimerScheduler, public SourceTimeListener {
public:
    static constexpr std::chrono::seconds kSilence{2};
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;
    using RemarkCallback = std::function<void(std::uint32_t packet, const StampRemark& remark)>;

    /// Both outlive the clock. `steadyNow` tells how long the source has been silent.
    SourceClock(const Clock& wallClock, TimerScheduler& wallTimers,
                SteadyNow steadyNow = std::chrono::steady_clock::now);
    ~SourceClock() override;
    SourceClock(const SourceClock&) = delete;
    SourceClock& operator=(const SourceClock&) = delete;

    /// Called when a source ends; an empty callback clears it.
    void onEnd(std::function<void()> callback) { _ended = std::move(callback); }
    /// Called when a packet's stamp is odd.
    void onStampRemark(RemarkCallback callback) { _remarked = std::move(callback); }

    /// The time that a played source's clock has reached; before there is any, and while the
    /// source is live, the wall clock's.
    Time now() const override;
    Zone zone(Time time) const override;
    std::unique_ptr<RepeatingTimer> scheduleRepeating(std::chrono::nanoseconds interval,
                                                      std::function<void()> action) override;

    void sourceBegan(bool isLive) override;
    bool advance(Time time) override;
    void packetNumber(std::uint32_t number) override { _packetNumber = number; }
    void stampRemark(std::uint32_t packet, const StampRemark& remark) override;
    void sourceEnded() override;

    /// The number of the latest packet in its source, counted from 1; 0 when it is not told.
    std::uint32_t packetNumber() const { return _packetNumber; }
    /// The latest source time as it was told, which for a packet is its stamp; `now` before there
    /// is any.
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
    bool _stretchEnds = false; ///< the timers do their last ticks
    std::optional<Time> _now;
    std::optional<Time> _stamp;
    std::uint32_t _packetNumber = 0;
    std::optional<std::chrono::steady_clock::time_point> _heard;
    std::list<std::weak_ptr<TimerState>> _timers; ///< in the order of their scheduling
};

} // namespace pallax
