#include "store/StoredRecordings.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace pallax {

std::optional<Event> storedEvent(std::int64_t time, std::int64_t packet, const std::string& kind,
                                 std::string words) {
    using std::chrono::microseconds;
    const auto known = eventKindNamed(kind);
    if (!known) {
        return std::nullopt;
    }
    const std::int64_t latest =
        std::chrono::floor<microseconds>(kLatestTime.time_since_epoch()).count();
    return Event{*known,
                 Time(microseconds(std::clamp<std::int64_t>(time, 0, latest))),
                 static_cast<std::uint64_t>(packet),
                 std::move(words),
                 {}};
}

} // namespace pallax
