#pragma once

#include "monitor/PallaxModel.h"
#include "timeline/StampSequence.h"
#include "timeline/TimeGrid.h"

#include <chrono>
#include <cstdint>
#include <optional>

namespace pallax {

/// The display ticks of a recording: tick n (from 1) stands n intervals after the first packet. A
/// gap of years costs as much as one of seconds.
///
/// Where the stamps step back, the stretch of time that ends there gets the tick that follows its
/// last packet. The next stretch has a grid of its own, from its first packet on; the numbers go
/// on.
class TickGrid {
public:
    static constexpr std::chrono::nanoseconds kInterval = PallaxModel::kDisplayInterval;

    struct Tick {
        std::uint64_t number;
        Time time;
    };

    /// A packet of that time comes next. The first tick that passes before it, if any does; of
    /// several only this one can see new data, the others just count. A packet at a tick's very
    /// time comes after it.
    std::optional<Tick> passedBefore(Time packet);

    /// The tick that follows whatever came last. Only after a packet.
    Tick next() const;

    /// How the latest packet's stamp stepped, if it did.
    const std::optional<StampRemark>& step() const { return _step; }

private:
    TimeGrid grid() const { return {_stamps.first(), kInterval}; }

    StampSequence _stamps;
    std::optional<StampRemark> _step;
    std::uint64_t _passed = 0;       // of the present stretch
    std::uint64_t _passedBefore = 0; // of the stretches before
};

} // namespace pallax
