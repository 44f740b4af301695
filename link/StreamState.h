#pragma once

#include "platform/RepeatingTimer.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>

namespace pallax {

/// Says in a few words why the display does not change: no connection, or no packet on a live
/// channel. Only a live channel must send packets; a recording may be silent by its own clock.
class StreamState {
public:
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    /// A connection may be missing for so long before it is spoken of.
    static constexpr std::chrono::seconds kPatience{1};
    /// Three display ticks without a packet.
    static constexpr std::chrono::seconds kSilence{6};

    struct Setup {
        TimerScheduler& timers;
        std::function<bool()> isConnected;
        std::function<bool()> isLive;
        std::function<std::uint64_t()> packets; ///< so many have arrived
        /// What a connection is waited for: "no service"; empty while unknown.
        std::function<std::string_view()> obstacle;
        /// Receives "connecting: no service" or "no data for 7 s", and an empty text once it no
        /// longer applies.
        std::function<void(const std::string& text)> say;
        SteadyNow steadyNow = std::chrono::steady_clock::now;
    };

    explicit StreamState(Setup setup);

private:
    void look();
    std::string text();

    Setup _setup;
    std::uint64_t _packets = 0;
    bool _wasConnected = false;
    /// When the latest packet arrived, or the connection began or ended, as far as `look` sees it.
    std::chrono::steady_clock::time_point _since;
    std::string _told;
    std::unique_ptr<RepeatingTimer> _looks;
};

} // namespace pallax
