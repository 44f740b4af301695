#pragma once

#include "decoding/DisplayOutput.h"
#include "decoding/StateCondition.h"
#include "watching/HeldCondition.h"
#include "watching/WatchAction.h"

#include <chrono>
#include <string>

namespace pallax {

class Clock;

/// Looks at a condition at each tick of one recording, and tells when it becomes true and ends.
class TickWatch final : public DisplayOutput {
public:
    /// All references must outlive the watch.
    struct Setup {
        const std::string& words; ///< of the condition
        StateCondition& condition;
        std::chrono::nanoseconds needed;
        const std::string& source;
        std::string_view named; ///< the name of the source in lines; may be empty
        const Clock& zone;
        Output& output;
        WatchAction& action;
    };

    explicit TickWatch(const Setup& setup) : _setup(setup), _held(setup.needed) {}

    void beginRecording() override {}
    void show(const DisplayMoment& moment, const PropertyList& display) override;

    /// Whether it has ever become true.
    bool hasHeld() const { return _hasHeld; }

private:
    void write(Time time, std::string_view kind, const std::string& words);
    WatchAction::Variables variables(const StateMoment& moment, const std::string& time) const;

    Setup _setup;
    HeldCondition _held;
    bool _hasHeld = false;
};

} // namespace pallax
