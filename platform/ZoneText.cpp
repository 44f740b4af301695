#include "platform/ZoneText.h"

#include "text/Format.h"

namespace pallax {

std::string zoneText(const Clock::Zone& zone) {
    using std::chrono::hours;
    using std::chrono::minutes;
    const auto offset = std::chrono::abs(std::chrono::duration_cast<minutes>(zone.offset));
    const auto whole = std::chrono::duration_cast<hours>(offset);
    return formatText("%@%02d%02d",
                      {zone.offset.count() < 0 ? "-" : "+", static_cast<int>(whole.count()),
                       static_cast<int>((offset - whole).count())});
}

std::string localTimeText(Time time, const Clock& clock) {
    const Clock::Zone zone = clock.zone(time);
    return formatText("%@ %@", {localDateText(time, zone.offset), zoneText(zone)});
}

} // namespace pallax
