#pragma once

#include "LogGenerator/Records/ArrayLock.h"

#include <chrono>
#include <future>
#include <thread>

namespace pallax::doubles {

/// Runs `work` in its own thread while this one holds the array lock, for up to `patience`, then
/// runs `meanwhile` in this thread, releases the lock and joins the thread. True if the work
/// finished while the lock was held, that is, without taking it.
template <class Work, class Meanwhile>
bool finishesUnderHeldArrayLock(std::chrono::milliseconds patience, const Work& work,
                                const Meanwhile& meanwhile) {
    std::promise<void> done;
    ArrayLock::lockArray();
    std::thread worker([&work, &done] {
        work();
        done.set_value();
    });
    const bool finished = done.get_future().wait_for(patience) == std::future_status::ready;
    meanwhile();
    ArrayLock::unlockArray();
    worker.join();
    return finished;
}

/// Time limit for work that must wait for the lock.
inline constexpr std::chrono::milliseconds kExpectedToWait{60};
/// Time limit for work that must not wait; only a failing test uses it up.
inline constexpr std::chrono::milliseconds kExpectedToFinish{10000};

} // namespace pallax::doubles
