#include "decoding/RecordingSpan.h"

#include "packets/StampSequence.h"

#include <algorithm>

namespace pallax {

std::optional<TimeSpan> spanOf(Recording& recording) {
    /// Memory must not grow with the recording: what follows counts as one stretch.
    constexpr std::size_t kMostStretches = 65536;
    std::optional<TimeSpan> span;
    StampSequence stamps;
    while (const auto packet = recording.next()) {
        const Time time = packet->time;
        if (!span) {
            span = TimeSpan{time, time, {}};
        }
        span->end = std::max(*span->end, time);
        auto& stretches = span->stretches;
        const bool isNew = stamps.isEmpty() || stamps.wouldStepBack(time);
        if (isNew && stretches.size() < kMostStretches) {
            stretches.push_back({time, time});
        }
        stretches.back().end = std::max(stretches.back().end, time);
        stamps.take(time);
    }
    return span;
}

} // namespace pallax
