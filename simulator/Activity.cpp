#include "simulator/Activity.h"

#include <algorithm>

namespace pallax {

namespace {

using std::chrono::milliseconds;
using Phase = Activity::Phase;

struct Span {
    milliseconds least;
    milliseconds most;
};

Span spanOf(Phase phase) {
    switch (phase) {
    case Phase::Off:
        return {milliseconds(300), milliseconds(500)};
    case Phase::Searching:
        return {milliseconds(800), milliseconds(1600)};
    case Phase::Registering:
        return {milliseconds(1600), milliseconds(2600)};
    case Phase::Idle:
        return {milliseconds(8000), milliseconds(15000)};
    case Phase::Updating:
        return {milliseconds(1600), milliseconds(2400)};
    case Phase::Connecting:
        return {milliseconds(700), milliseconds(1200)};
    case Phase::Connected:
        return {milliseconds(12000), milliseconds(24000)};
    case Phase::Releasing:
        return {milliseconds(600), milliseconds(1000)};
    }
    return {};
}

/// Short, so that the first session comes soon.
constexpr Span kFirstIdle = {milliseconds(4000), milliseconds(6000)};

milliseconds durationOf(const Span& span, Random& random) {
    const auto width = static_cast<unsigned>((span.most - span.least).count());
    return span.least + milliseconds(random.below(width + 1));
}

} // namespace

Activity::Activity(Random& random) {
    enter(Phase::Off, random);
}

void Activity::update(milliseconds step, bool newArea, Random& random) {
    constexpr double kLoadChange = 0.06;
    constexpr double kLeastLoad = 0.15;
    _hasChanged = false;
    _updateWaits = _updateWaits || (newArea && isRegistered());
    _left -= step;
    if (isConnected()) {
        _load = std::clamp(_load + random.normal() * kLoadChange, kLeastLoad, 1.0);
    }
    if (_phase == Phase::Idle && _updateWaits) {
        enter(Phase::Updating, random);
    } else if (_left <= milliseconds(0)) {
        enter(after(_phase), random);
    }
}

void Activity::enter(Phase phase, Random& random) {
    const bool isFirstIdle = phase == Phase::Idle && _firstIdle;
    _phase = phase;
    _hasChanged = true;
    _left = durationOf(isFirstIdle ? kFirstIdle : spanOf(phase), random);
    _load = phase == Phase::Connected ? random.between(0.4, 0.8) : 0;
    _firstIdle = _firstIdle && !isFirstIdle;
    _updateWaits = _updateWaits && phase != Phase::Updating;
}

Phase Activity::after(Phase phase) const {
    switch (phase) {
    case Phase::Off:
        return Phase::Searching;
    case Phase::Searching:
        return Phase::Registering;
    case Phase::Idle:
        return Phase::Connecting;
    case Phase::Connecting:
        return Phase::Connected;
    case Phase::Connected:
        return Phase::Releasing;
    case Phase::Registering:
    case Phase::Updating:
    case Phase::Releasing:
        break;
    }
    return Phase::Idle;
}

} // namespace pallax
