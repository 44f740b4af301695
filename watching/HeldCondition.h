#pragma once

#include "text/Date.h"

#include <chrono>
#include <optional>

namespace pallax {

/// Tells from tick to tick when a condition has become true: when it has held for some time.
class HeldCondition {
public:
    enum class Change {
        None,
        BecameTrue,
        Ended, ///< after it had become true
    };

    /// With a duration of zero it becomes true at the first tick at which it holds.
    explicit HeldCondition(std::chrono::nanoseconds needed = {}) : _needed(needed) {}

    /// Call this at each tick. A tick that is before the last one, because a clock was set back,
    /// counts as no time.
    Change at(Time tick, bool holds);

    /// How long it holds or, after it ended, held: from the first tick at which it did.
    std::chrono::nanoseconds held() const { return _held; }

private:
    std::chrono::nanoseconds _needed;
    std::chrono::nanoseconds _held{};
    std::optional<Time> _last; ///< the last tick
    bool _holds = false;       ///< at the last tick
    bool _isTrue = false;
};

} // namespace pallax
