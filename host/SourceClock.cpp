#include "host/SourceClock.h"

#include "platform/TimeGrid.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

/// Source times come from outside; within these bounds (1970 to 2116) no difference and no sum
/// with an interval can overflow.
Time bounded(Time time) {
    constexpr Time kLatest{std::chrono::nanoseconds(std::int64_t{1} << 62U)};
    return std::clamp(time, Time{}, kLatest);
}

} // namespace

struct SourceClock::TimerState {
    std::chrono::nanoseconds interval;
    std::function<void()> action;
    std::optional<Time> due; ///< nothing before the first source time
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
    return _now ? *_now : _wallClock.now();
}

Clock::Zone SourceClock::zone(Time time) const {
    return _wallClock.zone(time);
}

bool SourceClock::isSilent() const {
    return !_heard || _steadyNow() - *_heard >= kSilence;
}

std::unique_ptr<RepeatingTimer> SourceClock::scheduleRepeating(std::chrono::nanoseconds interval,
                                                               std::function<void()> action) {
    auto state = std::make_shared<TimerState>();
    state->interval = std::max(interval, std::chrono::nanoseconds(1));
    state->action = std::move(action);
    if (_first) {
        state->due = TimeGrid(*_first, state->interval).nextAfter(*_now);
    }
    state->wallTimer =
        _wallTimers.scheduleRepeating(interval, [this, weak = std::weak_ptr<TimerState>(state)] {
            const auto timer = weak.lock();
            if (timer != nullptr && timer->alive && isSilent()) {
                timer->action();
            }
        });
    _timers.push_back(state);
    return std::make_unique<Timer>(std::move(state));
}

void SourceClock::sourceBegan() {
    _first.reset();
}

bool SourceClock::advance(Time sourceTime) {
    const Time time = bounded(sourceTime);
    _heard = _steadyNow();
    _timers.remove_if([](const auto& timer) { return timer.expired(); });
    if (!_first) {
        _first = time;
        _now = time;
        for (const auto& timer : _timers) {
            const auto state = timer.lock();
            state->due = TimeGrid(time, state->interval).nextAfter(time);
        }
        return false;
    }
    std::shared_ptr<TimerState> earliest;
    for (const auto& timer : _timers) {
        auto state = timer.lock();
        if (state->alive && *state->due <= time && (!earliest || state->due < earliest->due)) {
            earliest = std::move(state);
        }
    }
    if (earliest == nullptr) {
        _now = std::max(*_now, time); // a recording's stamps may step back a little
        return false;
    }
    _now = std::max(*_now, *earliest->due);
    earliest->due = TimeGrid(*_first, earliest->interval).nextAfter(time);
    earliest->action();
    return true;
}

void SourceClock::sourceEnded() {
    if (_ended) {
        const auto callback = _ended; // which may replace itself
        callback();
    }
}

} // namespace pallax
