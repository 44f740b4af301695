#include "ui/contents/TimeOfDay.h"

namespace pallax {

std::string timeOfDay(Time time, std::chrono::seconds ahead) {
    constexpr std::size_t kDate = 11; // "2023-11-14 "
    return localDateText(time, ahead).substr(kDate);
}

} // namespace pallax
