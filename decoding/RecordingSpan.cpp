#include "decoding/RecordingSpan.h"

#include <algorithm>

namespace pallax {

std::optional<TimeSpan> spanOf(Recording& recording) {
    std::optional<TimeSpan> span;
    while (const auto packet = recording.next()) {
        if (!span) {
            span = TimeSpan{packet->time, packet->time};
        }
        span->end = std::max(*span->end, packet->time);
    }
    return span;
}

} // namespace pallax
