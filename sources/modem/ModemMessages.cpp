#include "sources/modem/ModemMessages.h"

#include "platform/MainQueue.h"
#include "plist/PropertyListCodec.h"

#include <utility>

namespace pallax {

ModemMessages::ModemMessages(Setup setup)
    : _setup(std::move(setup)), _time(_setup.clock.now()),
      _alive(std::make_shared<ModemMessages*>(this)) {}

void ModemMessages::after(std::chrono::nanoseconds delay, void (ModemMessages::*member)()) {
    _setup.queue.after(delay, [here = std::weak_ptr(_alive), member] {
        if (const auto messages = here.lock()) {
            ((*messages)->*member)();
        }
    });
}

void ModemMessages::changed() {
    _hasChanged = true;
    if (!_isPausing && !std::exchange(_isLooking, true)) {
        after(kGroup, &ModemMessages::lookForChange);
    }
}

void ModemMessages::lookForChange() {
    _isLooking = false;
    if (std::exchange(_hasChanged, false)) {
        make(false);
    }
}

void ModemMessages::endPause() {
    _isPausing = false;
    if (_hasChanged) {
        lookForChange();
    }
}

/// Makes a message, unless it would be that before.
void ModemMessages::make(bool isOverdue) {
    auto bytes = serializeBinary(_setup.picture());
    const bool isNew = bytes && (_latest == nullptr || *bytes != *_latest);
    if (!bytes || !(isNew || isOverdue)) {
        return;
    }
    _latest = std::make_shared<const ByteBuffer>(std::move(bytes).value());
    _time = _setup.clock.now();
    ++_count;
    _isPausing = true;
    after(kShortest, &ModemMessages::endPause);
    _setup.queue.after(kLongest, [here = std::weak_ptr(_alive), count = _count] {
        const auto messages = here.lock();
        if (messages != nullptr && (*messages)->_count == count) {
            (*messages)->_hasChanged = false;
            (*messages)->make(true);
        }
    });
    _setup.made();
}

} // namespace pallax
