#pragma once

#include "monitor/PallaxModel.h"
#include "platform/TimeGrid.h"

#include <chrono>
#include <cstdint>
#include <optional>

namespace pallax {

/// The display ticks of a recording: tick n (from 1) stands n intervals after the first packet. A
/// gap of years costs as much as one of seconds.
class TickGrid {
public:
    static constexpr std::chrono::nanoseconds kInterval = PallaxModel::kDisplayInterval;

    struct Tick {
        std::uint64_t number;
        Time time;
    };

    /// A packet of that time comes next. The first tick that passes before it, if any does; of
    /// several only this one can see new data, the others just count. A packet at a tick's very
    /// time comes after it; time that goes backwards makes no tick.
    std::optional<Tick> passedBefore(Time packet);

    /// The tick that follows whatever came last. Only after a packet.
    Tick next() const;

private:
    std::optional<TimeGrid> _grid; ///< from the first packet on
    std::uint64_t _passed = 0;
};

} // namespace pallax
