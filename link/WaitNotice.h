#pragma once

#include "platform/RepeatingTimer.h"

#include <chrono>
#include <functional>
#include <memory>
#include <string>

namespace pallax {

/// Tells the user what a program without a connection waits for: once it has waited for a second,
/// and again whenever that is something else.
class WaitNotice {
public:
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    static constexpr std::chrono::seconds kPatience{1};

    struct Setup {
        TimerScheduler& timers;
        std::function<bool()> isConnected;
        /// What is in the way, without a full stop; empty while that is not known.
        std::function<std::string()> obstacle;
        /// Gets one sentence without its full stop, and an empty text once it no longer holds.
        std::function<void(const std::string& text)> say;
        SteadyNow steadyNow = std::chrono::steady_clock::now;
    };

    /// The waiting begins now.
    explicit WaitNotice(Setup setup);

private:
    void look();

    Setup _setup;
    std::chrono::steady_clock::time_point _connected; ///< the latest look that found a connection
    std::string _told;
    std::unique_ptr<RepeatingTimer> _looks;
};

/// Says what a WaitNotice has to say on standard error.
void complainOfWaiting(const std::string& text);

} // namespace pallax
