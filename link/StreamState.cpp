#include "link/StreamState.h"

#include "text/AgeText.h"

#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kStateInterval{500};

} // namespace

StreamState::StreamState(Setup setup)
    : _setup(std::move(setup)), _since(_setup.steadyNow()),
      _looks(_setup.timers.scheduleRepeating(kStateInterval, [this] { look(); })) {}

void StreamState::look() {
    const std::string now = text();
    if (now != _told) {
        _told = now;
        _setup.say(now);
    }
}

std::string StreamState::text() {
    const bool isConnected = _setup.isConnected();
    const std::uint64_t packets = _setup.packets();
    const bool hasChanged = std::exchange(_wasConnected, isConnected) != isConnected;
    if (hasChanged || std::exchange(_packets, packets) != packets) {
        _since = _setup.steadyNow();
    }
    const auto silence = _setup.steadyNow() - _since;
    if (isConnected) {
        return _setup.isLive() && silence > kSilence ? "no data for " + ageText(silence) : "";
    }
    const std::string_view obstacle = _setup.obstacle();
    return silence < kPatience || obstacle.empty() ? ""
                                                   : std::string("connecting: ").append(obstacle);
}

} // namespace pallax
