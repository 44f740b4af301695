#pragma once

#include "platform/Clock.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>

namespace pallax {

/// Decides when to show the progress of a long run: first after two seconds, and then several times
/// a second.
class ProgressPace {
public:
    static constexpr std::chrono::seconds kPatience{2};
    static constexpr std::chrono::milliseconds kInterval{200};

    /// The run starts now.
    explicit ProgressPace(const Clock& clock) : _clock(clock), _begin(clock.now()), _look(_begin) {}

    /// Call this after each small piece of the run. It checks the clock rarely while the pieces are
    /// quick, and after each piece once they are slow; it misses the first slow ones, up to 63.
    bool isDue() {
        if (++_pieces < _piecesPerLook) {
            return false;
        }
        _pieces = 0;
        return look();
    }

private:
    bool look();

    const Clock& _clock;
    Time _begin;
    Time _look;                // the latest check
    std::optional<Time> _told; // when it was last due
    unsigned _pieces = 0;
    unsigned _piecesPerLook = 1;
};

/// "[##########                    ]  33 %"; `share` is from 0 to 1.
std::string progressBar(double share);

/// "1 packet", "2500 packets".
std::string packetCount(std::uint64_t packets);

} // namespace pallax
