#pragma once

#include "platform/Clock.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>

namespace pallax {

/// When it is time to tell how far a long run has come: not before it has taken two seconds, and
/// then a few times a second.
class ProgressPace {
public:
    static constexpr std::chrono::seconds kPatience{2};
    static constexpr std::chrono::milliseconds kInterval{200};

    /// The run begins now.
    explicit ProgressPace(const Clock& clock) : _clock(clock), _begin(clock.now()), _look(_begin) {}

    /// To be asked after each little piece of the run. It looks at the clock rarely where the
    /// pieces are quick, and at each of them once they are found to be slow: the first slow ones,
    /// up to 63, go unseen.
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
    Time _look;                // the latest
    std::optional<Time> _told; // when it was due the last time
    unsigned _pieces = 0;
    unsigned _piecesPerLook = 1;
};

/// "[##########                    ]  33 %"; `share` is from 0 to 1.
std::string progressBar(double share);

/// "1 packet", "2500 packets".
std::string packetCount(std::uint64_t packets);

} // namespace pallax
