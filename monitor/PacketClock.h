#pragma once

#include "platform/Clock.h"

namespace pallax {

/// The clock of a recording: shows the time of its latest packet or tick. Its zone is UTC.
class PacketClock final : public Clock {
public:
    Time now() const override { return _now; }
    Zone zone(Time /*time*/) const override { return {}; }
    void set(Time now) { _now = now; }

private:
    Time _now;
};

} // namespace pallax
