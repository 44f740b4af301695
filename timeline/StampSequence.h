#pragma once

#include "text/Date.h"

#include <chrono>
#include <optional>

namespace pallax {

/// What is odd about the stamp of a packet of a recording.
struct StampRemark {
    enum class Kind {
        StepBack = 1,  ///< it lies `size` before the latest stamp: a stretch of time ends
        Gap = 2,       ///< it lies `size` after the latest stamp
        OutOfRange = 3 ///< no Time can hold it, or nobody could show it; another one is taken
    };
    Kind kind = Kind::StepBack;
    std::chrono::nanoseconds size{0}; ///< not negative; 0 for OutOfRange

    friend bool operator==(const StampRemark&, const StampRemark&) = default;
};

/// The stamps of a recording, in the order of its packets. A stamp may lie a little before the
/// latest one, as it does where several sources were merged. One that lies further back (a clock
/// was set, two recordings were joined) ends a stretch of time and begins the next.
class StampSequence {
public:
    /// A stamp may lie that far back within a stretch.
    static constexpr std::chrono::seconds kMostJitter{2};
    /// A longer time without a packet is a gap.
    static constexpr std::chrono::seconds kMostPause{60};

    /// How a packet of that stamp would step, if it came next. The first one does not step.
    std::optional<StampRemark> stepTo(Time stamp) const;
    bool wouldStepBack(Time stamp) const;
    /// The packet has come.
    void take(Time stamp);

    bool isEmpty() const { return !_first; }
    /// Of the present stretch; only after a packet.
    Time first() const { return *_first; }
    Time latest() const { return _latest; }

private:
    std::optional<Time> _first;
    Time _latest;
};

} // namespace pallax
