#pragma once

#include "text/Date.h"

#include <chrono>
#include <optional>

namespace pallax {

/// An irregularity in the stamp of a packet.
struct StampRemark {
    enum class Kind {
        StepBack = 1,  ///< it is `size` before the latest stamp: a stretch of time ends
        Gap = 2,       ///< it is `size` after the latest stamp
        OutOfRange = 3 ///< it was outside kEarliestTime to kLatestTime and was replaced
    };
    Kind kind = Kind::StepBack;
    std::chrono::nanoseconds size{0}; ///< not negative; 0 for OutOfRange

    friend bool operator==(const StampRemark&, const StampRemark&) = default;
};

/// The stamps of a recording, in the order of its packets. A stamp may be slightly before the
/// latest one, as in merged recordings. One that is further back (a clock was set, recordings were
/// joined) ends a stretch of time and begins the next.
class StampSequence {
public:
    /// How far back a stamp may be within a stretch.
    static constexpr std::chrono::seconds kMostJitter{2};
    /// A longer time without a packet is a gap.
    static constexpr std::chrono::seconds kMostPause{60};

    /// The step that the next packet would make with this stamp. The first packet makes none.
    std::optional<StampRemark> stepTo(Time stamp) const;
    bool wouldStepBack(Time stamp) const;
    /// Adds the next packet's stamp.
    void take(Time stamp);

    bool isEmpty() const { return !_first; }
    /// The first stamp of the current stretch; valid only after a packet.
    Time first() const { return *_first; }
    Time latest() const { return _latest; }

private:
    std::optional<Time> _first;
    Time _latest;
};

} // namespace pallax
