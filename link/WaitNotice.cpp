#include "link/WaitNotice.h"

#include "host/Complaint.h"

#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kLookInterval{500};

} // namespace

WaitNotice::WaitNotice(Setup setup)
    : _setup(std::move(setup)), _connected(_setup.steadyNow()),
      _looks(_setup.timers.scheduleRepeating(kLookInterval, [this] { look(); })) {}

void WaitNotice::look() {
    const bool isConnected = _setup.isConnected();
    if (isConnected) {
        _connected = _setup.steadyNow();
    }
    const std::string obstacle = isConnected ? std::string() : _setup.obstacle();
    const bool isLong = _setup.steadyNow() - _connected >= kPatience;
    const std::string text = !isLong || obstacle.empty() ? std::string() : obstacle + "; waiting";
    if (text != _told) {
        _told = text;
        _setup.say(text);
    }
}

void complainOfWaiting(const std::string& text) {
    if (!text.empty()) {
        complain(text + ".");
    }
}

} // namespace pallax
