#include "host/SourceClock.h"

#include "packets/TimeGrid.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace pallax {

namespace {

/// The last tick comes after the latest possible packet.
constexpr Time kLatestTick = kLatestTime + std::chrono::minutes(1);

} // namespace

struct SourceClock::TimerState {
    std::chrono::nanoseconds interval;
    std::function<void()> action;
    std::optional<Time> due; ///< empty until a stretch of source times has started
    bool alive = true;
    std::unique_ptr<RepeatingTimer> wallTimer;
};

class SourceClock::Timer final : public RepeatingTimer {
public:
    explicit Timer(std::shared_ptr<TimerState> state) : _state(std::move(state)) {}
    ~Timer() override { end(); }
    Timer(const Timer&) = delete;
    Timer& operator=(const Timer&) = delete;

    void invalidate() override { end(); }

private:
    void end() {
        _state->alive = false;
        _state->wallTimer.reset();
    }

    std::shared_ptr<TimerState> _state;
};

SourceClock::SourceClock(const Clock& wallClock, TimerScheduler& wallTimers, SteadyNow steadyNow)
    : _wallClock(wallClock), _wallTimers(wallTimers), _steadyNow(std::move(steadyNow)) {}

SourceClock::~SourceClock() = default;

Time SourceClock::now() const {
    if (_isLive || !_now) {
        return _wallClock.now();
    }
    const bool runsOn = !_hasEnded && silence() > kSilence;
    return runsOn ? std::min(*_now + silence(), kLatestTime) : *_now;
}

Clock::Zone SourceClock::zone(Time time) const {
    return _wallClock.zone(time);
}

/// How long the source has been silent since its first source time.
std::chrono::nanoseconds SourceClock::silence() const {
    return _steadyNow() - *_heard;
}

bool SourceClock::firesByTheWall() const {
    return _isLive || !_heard || silence() >= kSilence;
}

std::unique_ptr<RepeatingTimer> SourceClock::scheduleRepeating(std::chrono::nanoseconds interval,
                                                               std::function<void()> action) {
    auto state = std::make_shared<TimerState>();
    state->interval = std::max(interval, std::chrono::nanoseconds(1));
    state->action = std::move(action);
    state->due = nextTick(state->interval);
    state->wallTimer =
        _wallTimers.scheduleRepeating(interval, [this, weak = std::weak_ptr<TimerState>(state)] {
            const auto timer = weak.lock();
            if (timer != nullptr && timer->alive && firesByTheWall()) {
                timer->action();
            }
        });
    _timers.push_back(state);
    return std::make_unique<Timer>(std::move(state));
}

/// For a timer that starts now.
std::optional<Time> SourceClock::nextTick(std::chrono::nanoseconds interval) const {
    if (_times.isEmpty() || _stretchEnds) {
        return std::nullopt;
    }
    return TimeGrid(_times.first(), interval).nextAfter(*_now);
}

void SourceClock::sourceBegan(bool isLive) {
    _isLive = isLive;
    _hasEnded = false;
    _stretchEnds = false;
    _times = {};
}

bool SourceClock::advance(Time sourceTime) {
    const Time time = std::clamp(sourceTime, kEarliestTime, kLatestTick);
    _stamp = std::min(time, kLatestTime);
    _heard = _steadyNow();
    _timers.remove_if([](const auto& timer) { return timer.expired(); });
    if (_isLive) {
        return false;
    }
    _stretchEnds = _times.wouldStepBack(time);
    if (const auto timer = earliestTimer(_stretchEnds ? Time::max() : time)) {
        _now = std::max(*_now, *timer->due);
        timer->due = _stretchEnds
                         ? std::nullopt
                         : std::optional(TimeGrid(_times.first(), timer->interval).nextAfter(time));
        timer->action();
        return true;
    }
    if (_times.isEmpty() || _stretchEnds) {
        beginStretch(time);
    }
    _times.take(time);
    _now = std::max(*_now, time); // a recording's stamps may step back slightly
    return false;
}

/// The earliest timer due by `latest`; null if there is none.
std::shared_ptr<SourceClock::TimerState> SourceClock::earliestTimer(Time latest) const {
    std::shared_ptr<TimerState> earliest;
    if (_times.isEmpty()) {
        return earliest;
    }
    for (const auto& timer : _timers) {
        auto state = timer.lock();
        if (state->alive && state->due && *state->due <= latest &&
            (!earliest || state->due < earliest->due)) {
            earliest = std::move(state);
        }
    }
    return earliest;
}

void SourceClock::beginStretch(Time time) {
    _stretchEnds = false;
    _now = time;
    for (const auto& timer : _timers) {
        const auto state = timer.lock();
        state->due = TimeGrid(time, state->interval).nextAfter(time);
    }
}

void SourceClock::stampRemark(std::uint32_t packet, const StampRemark& remark) {
    if (_remarked) {
        _remarked(packet, remark);
    }
}

/// A live source's service may exit before the timers fire again, so they fire now.
void SourceClock::sourceEnded() {
    _hasEnded = true;
    if (_isLive) {
        const std::vector<std::weak_ptr<TimerState>> timers(_timers.begin(), _timers.end());
        for (const auto& timer : timers) {
            if (const auto state = timer.lock(); state != nullptr && state->alive) {
                state->action();
            }
        }
    }
    if (_ended) {
        const auto callback = _ended; // which may replace itself
        callback();
    }
}

} // namespace pallax
