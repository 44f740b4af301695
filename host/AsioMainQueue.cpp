#include "host/AsioMainQueue.h"

#include "host/Interruption.h"

#include <asio/executor_work_guard.hpp>
#include <asio/io_context.hpp>
#include <asio/posix/stream_descriptor.hpp>
#include <asio/post.hpp>
#include <asio/signal_set.hpp>
#include <asio/steady_timer.hpp>

#include <optional>
#include <utility>

namespace pallax {

namespace {

/// The one conversion of delays for `Impl` and the timers.
std::chrono::steady_clock::duration steadyDuration(std::chrono::nanoseconds time) {
    return std::chrono::duration_cast<std::chrono::steady_clock::duration>(time);
}

/// The state shared by a repeating timer and its waiting handler.
struct TimerState : std::enable_shared_from_this<TimerState> {
    TimerState(asio::io_context& context, std::chrono::nanoseconds period,
               std::function<void()> what)
        : timer(context), interval(steadyDuration(period)), action(std::move(what)),
          due(std::chrono::steady_clock::now() + interval) {}

    void wait() {
        timer.expires_at(due);
        timer.async_wait([self = shared_from_this()](const asio::error_code& error) {
            if (!error && self->alive) {
                self->fire();
            }
        });
    }

    void fire() {
        const auto late = std::chrono::steady_clock::now() - due;
        due += interval * (1 + late / interval);
        wait(); // before the action, which may throw
        action();
    }

    asio::steady_timer timer;
    std::chrono::steady_clock::duration interval;
    std::function<void()> action;
    std::chrono::steady_clock::time_point due;
    bool alive = true;
};

class AsioRepeatingTimer final : public RepeatingTimer {
public:
    explicit AsioRepeatingTimer(std::shared_ptr<TimerState> state) : _state(std::move(state)) {
        _state->wait();
    }
    ~AsioRepeatingTimer() override { end(); }
    AsioRepeatingTimer(const AsioRepeatingTimer&) = delete;
    AsioRepeatingTimer& operator=(const AsioRepeatingTimer&) = delete;

    void invalidate() override { end(); }

private:
    void end() {
        _state->alive = false;
        _state->timer.cancel();
    }

    std::shared_ptr<TimerState> _state;
};

} // namespace

struct AsioMainQueue::Impl {
    asio::io_context context{1};
    asio::executor_work_guard<asio::io_context::executor_type> work{context.get_executor()};
    std::optional<asio::signal_set> signals;
    std::function<void(int)> signalAction;

    void waitForSignal() {
        signals->async_wait([this](const asio::error_code& error, int number) {
            if (!error) {
                waitForSignal();
                signalAction(number);
            }
        });
    }
};

AsioMainQueue::AsioMainQueue() : _impl(std::make_unique<Impl>()) {}
AsioMainQueue::~AsioMainQueue() = default;

void AsioMainQueue::async(Block block) {
    asio::post(_impl->context, std::move(block));
}

void AsioMainQueue::after(std::chrono::nanoseconds delay, Block block) {
    auto timer = std::make_shared<asio::steady_timer>(_impl->context, steadyDuration(delay));
    auto& waiting = *timer;
    waiting.async_wait(
        [timer = std::move(timer), block = std::move(block)](const asio::error_code& error) {
            if (!error) {
                block();
            }
        });
}

std::unique_ptr<RepeatingTimer> AsioMainQueue::scheduleRepeating(std::chrono::nanoseconds interval,
                                                                 std::function<void()> action) {
    return std::make_unique<AsioRepeatingTimer>(
        std::make_shared<TimerState>(_impl->context, interval, std::move(action)));
}

void AsioMainQueue::run() {
    _impl->context.run();
    _impl->context.restart();
}

bool AsioMainQueue::runReady() {
    _impl->context.poll();
    const bool isStopped = _impl->context.stopped();
    _impl->context.restart();
    return !isStopped;
}

bool AsioMainQueue::runTurn(std::optional<std::chrono::nanoseconds> longest) {
    constexpr std::chrono::milliseconds kTurn{8}; // half a frame of a usual screen
    if (longest) {
        _impl->context.run_one_for(steadyDuration(*longest));
    } else {
        _impl->context.run_one();
    }
    const auto end = std::chrono::steady_clock::now() + kTurn;
    while (std::chrono::steady_clock::now() < end && _impl->context.poll_one() != 0) {
    }
    const bool isStopped = _impl->context.stopped();
    _impl->context.restart();
    return !isStopped;
}

void AsioMainQueue::stop() {
    _impl->context.stop();
}

void AsioMainQueue::onSignal(std::initializer_list<int> signals, std::function<void(int)> action) {
    _impl->signals.emplace(_impl->context);
    for (const int number : signals) {
        _impl->signals->add(number);
        Interruption::watch(number);
    }
    _impl->signalAction = std::move(action);
    _impl->waitForSignal();
}

struct DescriptorWatch::State {
    State(asio::io_context& context, int number) : descriptor(context, number) {}
    asio::posix::stream_descriptor descriptor;
};

DescriptorWatch::DescriptorWatch(AsioMainQueue& queue, int descriptor)
    : _state(std::make_shared<State>(queue._impl->context, descriptor)) {}

DescriptorWatch::~DescriptorWatch() {
    (void)_state->descriptor.release();
}

namespace {

/// A handler that drops `action` once the watch is destroyed.
template <class State>
auto onceAlive(std::weak_ptr<State> state, std::function<void()> action) {
    return [state = std::move(state), action = std::move(action)](const asio::error_code& error) {
        if (!error && !state.expired()) {
            action();
        }
    };
}

} // namespace

void DescriptorWatch::onceReadable(std::function<void()> action) {
    _state->descriptor.async_wait(asio::posix::descriptor_base::wait_read,
                                  onceAlive(std::weak_ptr<State>(_state), std::move(action)));
}

void DescriptorWatch::onceWritable(std::function<void()> action) {
    _state->descriptor.async_wait(asio::posix::descriptor_base::wait_write,
                                  onceAlive(std::weak_ptr<State>(_state), std::move(action)));
}

} // namespace pallax
