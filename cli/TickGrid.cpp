#include "cli/TickGrid.h"

namespace pallax {

namespace {

constexpr auto kIntervalCount = static_cast<std::uint64_t>(TickGrid::kInterval.count());

std::uint64_t bits(Time time) {
    return static_cast<std::uint64_t>(time.time_since_epoch().count());
}

/// The distance of two times that a signed number may be too small for; `to` is not earlier.
std::uint64_t nanosecondsBetween(Time from, Time to) {
    return bits(to) - bits(from);
}

} // namespace

std::optional<TickGrid::Tick> TickGrid::passedBefore(Time packet) {
    if (!_first) {
        _first = packet;
    }
    if (packet <= *_first) {
        return std::nullopt;
    }
    const std::uint64_t passed = nanosecondsBetween(*_first, packet) / kIntervalCount;
    if (passed <= _passed) {
        return std::nullopt;
    }
    const Tick tick = next();
    _passed = passed;
    return tick;
}

TickGrid::Tick TickGrid::next() const {
    const std::uint64_t number = _passed + 1;
    const Time first = _first.value_or(Time());
    const bool beyond = number > nanosecondsBetween(first, Time::max()) / kIntervalCount;
    const auto time = static_cast<std::int64_t>(bits(first) + number * kIntervalCount);
    return {number, beyond ? Time::max() : Time(std::chrono::nanoseconds(time))};
}

} // namespace pallax
