#pragma once

#include "platform/MainQueue.h"
#include "platform/RepeatingTimer.h"

#include <cstdint>
#include <map>
#include <utility>

namespace pallax::doubles {

/// The main queue and its timers with their own time, which only `advance` moves. Blocks run in the
/// order in which they fall due, then in the order in which they were posted. An exception of a
/// block propagates through the call that ran it; the block is then gone.
class SteppedQueue final : public MainQueue, public TimerScheduler {
public:
    using Duration = std::chrono::nanoseconds;

    void async(Block block) override { post(_now, std::move(block)); }
    void after(Duration delay, Block block) override { post(_now + delay, std::move(block)); }
    std::unique_ptr<RepeatingTimer> scheduleRepeating(Duration interval,
                                                      std::function<void()> action) override {
        auto state = std::make_shared<TimerState>();
        state->interval = interval;
        state->action = std::move(action);
        arm(state);
        return std::make_unique<Timer>(std::move(state));
    }

    /// Runs the next due block; false if there is none.
    bool step() {
        if (_blocks.empty() || _blocks.begin()->first.first > _now) {
            return false;
        }
        const Block block = std::move(_blocks.extract(_blocks.begin()).mapped());
        block();
        return true;
    }

    /// Runs blocks until none is due, including those posted in the meantime.
    void runReady() {
        while (step()) {
        }
    }

    /// Advances the time; due blocks run at their own time.
    void advance(Duration duration) {
        const Duration end = _now + duration;
        runReady();
        while (!_blocks.empty() && _blocks.begin()->first.first <= end) {
            _now = _blocks.begin()->first.first;
            runReady();
        }
        _now = end;
    }

    /// The time since the queue was created.
    Duration now() const { return _now; }

private:
    struct TimerState {
        Duration interval{0};
        std::function<void()> action;
        bool active = true;
    };

    class Timer final : public RepeatingTimer {
    public:
        explicit Timer(std::shared_ptr<TimerState> state) : _state(std::move(state)) {}
        ~Timer() override { _state->active = false; }
        Timer(const Timer&) = delete;
        Timer& operator=(const Timer&) = delete;
        void invalidate() override { _state->active = false; }

    private:
        std::shared_ptr<TimerState> _state;
    };

    void post(Duration due, Block block) {
        _blocks.emplace(std::pair{due, _sequence++}, std::move(block));
    }

    void arm(const std::shared_ptr<TimerState>& state) {
        post(_now + state->interval, [this, weak = std::weak_ptr(state)] {
            const auto timer = weak.lock(); // keeps the action alive while it runs
            if (timer && timer->active) {
                arm(timer);
                timer->action();
            }
        });
    }

    Duration _now{0};
    std::uint64_t _sequence = 0;
    std::map<std::pair<Duration, std::uint64_t>, Block> _blocks;
};

} // namespace pallax::doubles
