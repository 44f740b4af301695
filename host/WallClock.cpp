#include "host/WallClock.h"

#include <ctime>

namespace pallax {

Time WallClock::now() const {
    return std::chrono::time_point_cast<std::chrono::nanoseconds>(std::chrono::system_clock::now());
}

Clock::Zone WallClock::zone(Time time) const {
    const std::time_t seconds = dateOf(time).time_since_epoch().count();
    std::tm local{};
    if (::localtime_r(&seconds, &local) == nullptr) {
        return {};
    }
    return {std::chrono::seconds(local.tm_gmtoff), local.tm_isdst > 0};
}

} // namespace pallax
