#pragma once

#include "platform/RepeatingTimer.h"

#include <chrono>
#include <functional>
#include <memory>
#include <string>

namespace pallax {

/// Tells the user why a program is not connected: after one second without a connection, and again
/// whenever the reason changes.
class WaitNotice {
public:
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    static constexpr std::chrono::seconds kPatience{1};

    struct Setup {
        TimerScheduler& timers;
        std::function<bool()> isConnected;
        /// The reason, without a full stop; empty while unknown.
        std::function<std::string()> obstacle;
        /// Receives one sentence without its full stop, and an empty text once it no longer
        /// applies.
        std::function<void(const std::string& text)> say;
        SteadyNow steadyNow = std::chrono::steady_clock::now;
    };

    /// The wait starts now.
    explicit WaitNotice(Setup setup);

private:
    void look();

    Setup _setup;
    std::chrono::steady_clock::time_point _connected; ///< the latest check that found a connection
    std::string _told;
    std::unique_ptr<RepeatingTimer> _looks;
};

/// Prints the text of a WaitNotice on standard error.
void complainOfWaiting(const std::string& text);

} // namespace pallax
