#pragma once

#include <ctime>

namespace pallax {

/// Of this process; less affected by other programs than wall-clock time.
inline double processorSeconds() {
    timespec time{};
    (void)::clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
    constexpr double kPerNanosecond = 1e-9;
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * kPerNanosecond;
}

} // namespace pallax
