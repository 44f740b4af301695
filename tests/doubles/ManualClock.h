#pragma once

#include "platform/Clock.h"

namespace pallax::doubles {

/// A clock that only tests move: initially 2023-11-14 22:13:20 UTC, in the zone UTC.
class ManualClock final : public Clock {
public:
    static constexpr Time kStart{std::chrono::seconds{1700000000}};

    explicit ManualClock(Time start = kStart) : _now(start) {}

    Time now() const override { return _now; }
    Zone zone(Time /*time*/) const override { return _zone; }

    void set(Time now) { _now = now; }
    void advance(std::chrono::nanoseconds duration) { _now += duration; }
    void setZone(Zone zone) { _zone = zone; }

private:
    Time _now;
    Zone _zone;
};

} // namespace pallax::doubles
