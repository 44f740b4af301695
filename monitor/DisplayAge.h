#pragma once

#include "text/Date.h"

#include <optional>

namespace pallax {

/// Tells whether the display is current or keeps old values after a restart of the link.
class DisplayAge {
public:
    /// New data was shown.
    void shown(Time now) {
        if (!_left) {
            _lastShown = now;
        }
    }
    /// The same arguments as for ModelObserver.
    void generatorChosen(bool keepsDisplay, Time now) {
        if (!keepsDisplay) {
            _left.reset();
        } else if (!_left) {
            _left = _lastShown.value_or(now);
        }
    }
    /// The time of the last update, if the shown values are no longer updated.
    const std::optional<Time>& left() const { return _left; }

private:
    std::optional<Time> _lastShown; ///< while the display was current
    std::optional<Time> _left;
};

} // namespace pallax
