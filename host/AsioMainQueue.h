#pragma once

#include "platform/MainQueue.h"
#include "platform/RepeatingTimer.h"
#include "platform/RunLoop.h"

#include <chrono>
#include <functional>
#include <initializer_list>
#include <memory>
#include <optional>

namespace pallax {

/// The main queue, its timers and its loop, on Asio. Blocks, timers, signals and descriptor watches
/// all run inside `run`, `runReady` or `runTurn`; only `async` may be called from another thread.
class AsioMainQueue final : public MainQueue, public TimerScheduler, public RunLoop {
public:
    AsioMainQueue();
    ~AsioMainQueue() override;
    AsioMainQueue(const AsioMainQueue&) = delete;
    AsioMainQueue& operator=(const AsioMainQueue&) = delete;

    void async(Block block) override;
    void after(std::chrono::nanoseconds delay, Block block) override;
    /// If the queue was busy at a firing, that firing is skipped; later ones keep to the grid.
    std::unique_ptr<RepeatingTimer> scheduleRepeating(std::chrono::nanoseconds interval,
                                                      std::function<void()> action) override;

    void run() override;
    bool runReady() override;
    void stop() override;
    /// For a loop that takes turns with another one on the same thread: waits for a block, at most
    /// `longest` (nothing: until one comes), then runs what is ready, but only for some
    /// milliseconds, so that the other loop gets its turn under any load. False once after `stop`.
    /// An exception leaves as from `run`.
    bool runTurn(std::optional<std::chrono::nanoseconds> longest);

    /// Calls `action` as a block for each of these signals, instead of their default action. A
    /// later call replaces an earlier one.
    void onSignal(std::initializer_list<int> signals, std::function<void(int)> action);

private:
    friend class DescriptorWatch;
    struct Impl;
    std::unique_ptr<Impl> _impl;
};

/// Waits for a file descriptor that it does not own; must be destroyed before the descriptor is
/// closed. Destruction cancels a pending wait.
class DescriptorWatch {
public:
    /// Throws std::system_error for a descriptor that cannot be watched.
    DescriptorWatch(AsioMainQueue& queue, int descriptor);
    ~DescriptorWatch();
    DescriptorWatch(const DescriptorWatch&) = delete;
    DescriptorWatch& operator=(const DescriptorWatch&) = delete;

    /// Calls `action` once, as a block, when there is data to read or the end has been reached.
    void onceReadable(std::function<void()> action);
    /// Calls `action` once, as a block, when it is possible to write.
    void onceWritable(std::function<void()> action);

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace pallax
