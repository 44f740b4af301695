#pragma once

#include "monitor/PallaxModel.h"
#include "packets/StampSequence.h"
#include "packets/TimeGrid.h"

#include <chrono>
#include <cstdint>
#include <optional>

namespace pallax {

/// The display ticks of a recording: tick n (from 1) is n intervals after the first packet. A gap
/// of years costs no more than one of seconds.
///
/// When the stamps step back, the stretch of time that ends gets the tick after its last packet.
/// The next stretch has its own grid, starting at its first packet; the tick numbers continue.
class TickGrid {
public:
    static constexpr std::chrono::nanoseconds kInterval = PallaxModel::kDisplayInterval;

    struct Tick {
        std::uint64_t number;
        Time time;
    };

    /// The next packet has this time. Returns the first tick that passes before it, if any; of
    /// several, only this one can show new data, the others just count. A packet at exactly a
    /// tick's time comes after it.
    std::optional<Tick> passedBefore(Time packet);

    /// The tick after the last packet or tick. Only valid after a packet.
    Tick next() const;

    /// The step of the latest packet's stamp, if any.
    const std::optional<StampRemark>& step() const { return _step; }

private:
    std::optional<Tick> passedTick(Time packet);
    TimeGrid grid() const { return {_stamps.first(), kInterval}; }

    StampSequence _stamps;
    std::optional<StampRemark> _step;
    Time _nextTick = Time::min();
    std::uint64_t _passed = 0;       // in the current stretch
    std::uint64_t _passedBefore = 0; // in earlier stretches
};

} // namespace pallax
