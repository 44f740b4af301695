#pragma once

#include "timeline/Timeline.h"

#include <chrono>
#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// The numbers that were read in a short time.
struct CurvePoint {
    Time time; ///< of the first
    double first = 0;
    double least = 0;
    double most = 0;
    double last = 0;
};

/// The numbers of one field and entry over a time.
struct Curve {
    std::vector<CurvePoint> points; ///< by time
    /// Points that are farther apart have nothing between them.
    std::chrono::nanoseconds gap{0};
    bool isReduced = false; ///< a point may stand for several numbers
};

/// The point at a time: the latest that is not later; null if there is none.
const CurvePoint* pointAt(const Curve& curve, Time time);

/// Something that happened in the time of a curve.
struct CurveEvent {
    Time time;
    std::string words;
};

/// The packets of a time that ends at an instant.
struct CurveWindow {
    std::uint64_t firstPacket = 1;
    std::uint64_t lastPacket = 0; ///< less than the first: there are none
    Time from;
    Time to;
};

/// The stretch that contains a packet; null if there is none.
const Stretch* stretchWith(const Timeline& timeline, std::uint64_t packet);
/// The time of an instant's packet; nothing if the journal does not have it.
std::optional<Time> timeOf(const Timeline& timeline, std::uint64_t instant);

/// So much time until an instant; without `span`, all of it. The clock does not step in it.
CurveWindow windowUntil(const Timeline& timeline, std::uint64_t instant,
                        std::optional<std::chrono::seconds> span);

/// The curve of a window, with as many points as there are numbers or, of many packets, at least
/// `count` if there are so many. Then the first and the last point may contain numbers of packets
/// shortly before and after the window.
Curve readCurve(Timeline& timeline, FieldIndex field, EntryId entry, const CurveWindow& window,
                std::size_t count);

} // namespace pallax
