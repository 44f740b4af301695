#include "packets/TimeGrid.h"

namespace pallax {

namespace {

std::uint64_t bits(Time time) {
    return static_cast<std::uint64_t>(time.time_since_epoch().count());
}

/// The number of whole intervals between two times, whose distance may overflow a signed number;
/// `to` must not be before `from`.
std::uint64_t intervalsBetween(Time from, Time to, std::chrono::nanoseconds interval) {
    return (bits(to) - bits(from)) / static_cast<std::uint64_t>(interval.count());
}

} // namespace

std::uint64_t TimeGrid::passedAt(Time time) const {
    return time > _first ? intervalsBetween(_first, time, _interval) : 0;
}

Time TimeGrid::moment(std::uint64_t number) const {
    if (number > intervalsBetween(_first, Time::max(), _interval)) {
        return Time::max();
    }
    const std::uint64_t time =
        bits(_first) + number * static_cast<std::uint64_t>(_interval.count());
    return Time(std::chrono::nanoseconds(static_cast<std::int64_t>(time)));
}

} // namespace pallax
