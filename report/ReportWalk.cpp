#include "report/ReportWalk.h"

#include "query/TimelineTables.h"
#include "timeline/Timeline.h"

#include <optional>

namespace pallax {

std::uint64_t firstPacketAround(const Timeline& timeline, std::uint64_t packet) {
    std::uint64_t first = 0;
    for (const Stretch& stretch : timeline.stretches()) {
        first = stretch.firstPacket <= packet ? stretch.firstPacket : first;
    }
    return first;
}

void gatherTicks(Timeline& timeline, ReportBuilder& report,
                 const std::function<bool(const TickWalk::State& state)>& isWanted) {
    constexpr std::chrono::seconds kGap{60}; // as an event "gap"
    const TimelineKeyFrame* first = timeline.keyFrames().atOrBefore(timeline.firstInstant());
    if (first == nullptr) {
        return;
    }
    TickWalk walk(timeline, *first);
    std::optional<Time> before;
    bool isAfterStep = false;
    while (walk.next({1, timeline.packets()}, false)) {
        const TickWalk::State& state = *walk.current();
        const Time time = state.tick.time;
        isAfterStep = isAfterStep || (before && (time < *before || time - *before > kGap));
        before = time;
        if (isWanted(state)) {
            report.take({time, state.values, walk.display(), isAfterStep,
                         firstPacketAround(timeline, state.packet)});
            isAfterStep = false;
        } else {
            isAfterStep = true; // it is not known to go on
        }
    }
}

} // namespace pallax
