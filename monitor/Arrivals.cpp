#include "monitor/Arrivals.h"

#include <algorithm>

namespace pallax {

void Arrivals::note(Time time) {
    if (_last && time > *_last) {
        _intervals.at(_next) = time - *_last;
        _next = (_next + 1) % kKept;
        ++_count;
    }
    _last = time;
}

std::optional<std::chrono::nanoseconds> Arrivals::median() const {
    const auto kept = static_cast<std::ptrdiff_t>(std::min(_count, kKept));
    if (kept == 0) {
        return std::nullopt;
    }
    auto sorted = _intervals;
    const auto end = sorted.begin() + kept;
    const auto middle = sorted.begin() + kept / 2;
    std::nth_element(sorted.begin(), middle, end);
    if (kept % 2 != 0) {
        return *middle;
    }
    const auto below = *std::max_element(sorted.begin(), middle);
    return below + (*middle - below) / 2;
}

std::optional<std::chrono::nanoseconds> Arrivals::patience() const {
    if (_count + 1 < kLeast) {
        return std::nullopt;
    }
    return std::max<std::chrono::nanoseconds>(3 * *median(), kLeastPatience);
}

} // namespace pallax
