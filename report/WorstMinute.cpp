#include "report/WorstMinute.h"

#include <cmath>

namespace pallax {

namespace {

constexpr std::chrono::seconds kMinute{60};
constexpr double kEnoughKnown = 45; ///< seconds of it

Time endOf(Time from, double seconds) {
    return from + std::chrono::nanoseconds(std::llround(seconds * 1e9));
}

} // namespace

void WorstMinute::add(Time from, double seconds, double value, std::uint32_t stretch) {
    _held.push_back({from, seconds, value});
    _seconds += seconds;
    _sum += seconds * value;
    const Time end = endOf(from, seconds);
    while (end - _held.front().from > kMinute) {
        _seconds -= _held.front().seconds;
        _sum -= _held.front().seconds * _held.front().value;
        _held.pop_front();
        if (_held.empty()) {
            return;
        }
    }
    if (_seconds < kEnoughKnown) {
        return;
    }
    const double mean = _sum / _seconds;
    const bool isWorse = !_found || (_isSmallerBetter ? mean > _found->mean : mean < _found->mean);
    if (isWorse) {
        _found = {_held.front().from, end, mean, stretch};
    }
}

} // namespace pallax
