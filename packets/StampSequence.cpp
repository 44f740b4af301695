#include "packets/StampSequence.h"

#include <algorithm>
#include <cstdint>
#include <limits>

namespace pallax {

namespace {

/// From the earlier time to the later one; limited to the range of a duration.
std::chrono::nanoseconds distance(Time earlier, Time later) {
    const auto bits = [](Time time) {
        return static_cast<std::uint64_t>(time.time_since_epoch().count());
    };
    constexpr std::uint64_t kMost = std::numeric_limits<std::int64_t>::max();
    return std::chrono::nanoseconds(
        static_cast<std::int64_t>(std::min(bits(later) - bits(earlier), kMost)));
}

} // namespace

std::optional<StampRemark> StampSequence::stepTo(Time stamp) const {
    if (isEmpty()) {
        return std::nullopt;
    }
    if (wouldStepBack(stamp)) {
        return StampRemark{StampRemark::Kind::StepBack, distance(stamp, _latest)};
    }
    if (stamp > _latest && distance(_latest, stamp) > kMostPause) {
        return StampRemark{StampRemark::Kind::Gap, distance(_latest, stamp)};
    }
    return std::nullopt;
}

bool StampSequence::wouldStepBack(Time stamp) const {
    return !isEmpty() && stamp < _latest && distance(stamp, _latest) > kMostJitter;
}

void StampSequence::take(Time stamp) {
    if (isEmpty() || wouldStepBack(stamp)) {
        _first = stamp;
        _latest = stamp;
    }
    _latest = std::max(_latest, stamp);
}

} // namespace pallax
