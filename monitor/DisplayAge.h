#pragma once

#include "text/Date.h"

#include <optional>

namespace pallax {

/// Tells a display that follows the modem from one that a restarted link has left with its values.
class DisplayAge {
public:
    /// New data was shown.
    void shown(Time now) {
        if (!_left) {
            _lastShown = now;
        }
    }
    /// As ModelObserver is told it.
    void generatorChosen(bool keepsDisplay, Time now) {
        if (!keepsDisplay) {
            _left.reset();
        } else if (!_left) {
            _left = _lastShown.value_or(now);
        }
    }
    /// When the values that are shown came, if none of them follows the modem any more.
    const std::optional<Time>& left() const { return _left; }

private:
    std::optional<Time> _lastShown; ///< while the values followed the modem
    std::optional<Time> _left;
};

} // namespace pallax
