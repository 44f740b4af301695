#pragma once

#include "simulator/Random.h"

#include <chrono>

namespace pallax {

/// What the phone does with its network, whatever the technology.
class Activity {
public:
    enum class Phase {
        Off,
        Searching,
        Registering,
        Idle,
        Updating,   ///< tells the network in which area it is
        Connecting, ///< a data session begins
        Connected,
        Releasing
    };

    explicit Activity(Random& random);

    /// Time goes on by `step`; `newArea`: the camped cell lies in another area than before.
    void update(std::chrono::milliseconds step, bool newArea, Random& random);

    Phase phase() const { return _phase; }
    /// True when the latest update brought another phase.
    bool hasChanged() const { return _hasChanged; }
    bool isRegistered() const { return _phase >= Phase::Idle; }
    /// Anything goes over the air in both directions.
    bool isConnected() const { return _phase == Phase::Connected; }
    /// Of the data session: 0 (nothing) to 1 (all that the cell can give).
    double load() const { return _load; }

private:
    void enter(Phase phase, Random& random);
    Phase after(Phase phase) const;

    Phase _phase = Phase::Off;
    std::chrono::milliseconds _left{0};
    double _load = 0;
    bool _hasChanged = true;
    bool _updateWaits = false; // a new area was met while another phase went on
    bool _firstIdle = true;
};

} // namespace pallax
