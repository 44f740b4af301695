#pragma once

#include "text/Date.h"

#include <optional>

namespace pallax {

/// Tells whether the display is current, or a restarted link has left it with old values.
class DisplayAge {
public:
    /// New data was shown.
    void shown(Time now) {
        if (!_left) {
            _lastShown = now;
        }
    }
    /// As told to ModelObserver.
    void generatorChosen(bool keepsDisplay, Time now) {
        if (!keepsDisplay) {
            _left.reset();
        } else if (!_left) {
            _left = _lastShown.value_or(now);
        }
    }
    /// If the values on display are no longer updated: the time of the last update.
    const std::optional<Time>& left() const { return _left; }

private:
    std::optional<Time> _lastShown; ///< while the display was current
    std::optional<Time> _left;
};

} // namespace pallax
