#pragma once

#include "platform/Clock.h"

namespace pallax {

/// The machine's clock and its local time zone.
class WallClock final : public Clock {
public:
    Time now() const override;
    Zone zone(Time time) const override;
};

} // namespace pallax
