#pragma once

#include "simulator/Random.h"

#include <chrono>

namespace pallax {

/// The phone's use of its network, for all technologies.
class Activity {
public:
    enum class Phase {
        Off,
        Searching,
        Registering,
        Idle,
        Updating,   ///< tells the network its area
        Connecting, ///< a data session begins
        Connected,
        Releasing
    };

    explicit Activity(Random& random);

    /// Advances by `step`; `newArea`: the camped cell is in another area than before.
    void update(std::chrono::milliseconds step, bool newArea, Random& random);

    Phase phase() const { return _phase; }
    /// True if the latest update changed the phase.
    bool hasChanged() const { return _hasChanged; }
    bool isRegistered() const { return _phase >= Phase::Idle; }
    /// Whether data are sent in both directions.
    bool isConnected() const { return _phase == Phase::Connected; }
    /// The load of the data session: 0 (none) to 1 (the cell's maximum).
    double load() const { return _load; }

private:
    void enter(Phase phase, Random& random);
    Phase after(Phase phase) const;

    Phase _phase = Phase::Off;
    std::chrono::milliseconds _left{0};
    double _load = 0;
    bool _hasChanged = true;
    bool _updateWaits = false; // entered a new area during another phase
    bool _firstIdle = true;
};

} // namespace pallax
