#include "watching/HeldCondition.h"

#include <algorithm>
#include <utility>

namespace pallax {

HeldCondition::Change HeldCondition::at(Time tick, bool holds) {
    const bool held = std::exchange(_holds, holds);
    const Time last = std::exchange(_last, tick).value_or(tick);
    if (held) {
        _held += std::max(tick - last, std::chrono::nanoseconds(0));
    } else if (holds) {
        _held = {};
    }
    if (!holds) {
        return std::exchange(_isTrue, false) ? Change::Ended : Change::None;
    }
    const bool wasTrue = std::exchange(_isTrue, _isTrue || _held >= _needed);
    return _isTrue && !wasTrue ? Change::BecameTrue : Change::None;
}

} // namespace pallax
