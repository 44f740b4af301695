#pragma once

#include "LogGenerator/Records/ArrayLock.h"

#include <chrono>
#include <future>
#include <thread>

namespace pallax::doubles {

/// Runs `work` in a thread of its own while this one holds the array lock, for up to `patience`,
/// then `meanwhile` in this one, lets go and waits for the thread's end. True when the work was
/// done under the held lock, so without taking it.
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

/// How long work gets that must wait for the lock.
inline constexpr std::chrono::milliseconds kExpectedToWait{60};
/// How long work gets that must not: an end for a failing test, not a delay for a passing one.
inline constexpr std::chrono::milliseconds kExpectedToFinish{10000};

} // namespace pallax::doubles
