#pragma once

#include <cmath>
#include <cstdint>
#include <vector>

namespace pallax {

/// A number over the ticks, kept where it changes. It holds until the next change.
class HeldSeries {
public:
    struct Change {
        std::uint32_t tick; ///< from 0
        float value;        ///< NaN: the number is not known from here on
    };

    /// The number at a tick, which must not be before the latest one.
    void add(std::uint32_t tick, double number) {
        const auto value = static_cast<float>(number);
        const bool isKnown = !std::isnan(value);
        const bool wasKnown = !_changes.empty() && !std::isnan(_changes.back().value);
        if (isKnown != wasKnown || (isKnown && value != _changes.back().value)) {
            _changes.push_back({tick, value});
        }
    }
    const std::vector<Change>& changes() const { return _changes; }

private:
    std::vector<Change> _changes;
};

} // namespace pallax
