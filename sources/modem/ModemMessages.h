#pragma once

#include "platform/Clock.h"
#include "plist/PropertyList.h"
#include "text/Bytes.h"
#include "text/Date.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>

namespace pallax {

class MainQueue;

/// Makes the messages of the object stream: at most one a second when the picture changes, and at
/// least one in five seconds.
class ModemMessages {
public:
    /// Changes come in groups, which make one message.
    static constexpr std::chrono::milliseconds kGroup{100};
    static constexpr std::chrono::seconds kShortest{1};
    static constexpr std::chrono::seconds kLongest{5};

    struct Setup {
        MainQueue& queue;
        const Clock& clock; ///< for the stamps
        std::function<Dictionary()> picture;
        std::function<void()> made; ///< there is a new message
    };

    /// The references in the setup must outlive the messages.
    explicit ModemMessages(Setup setup);
    ModemMessages(const ModemMessages&) = delete;
    ModemMessages& operator=(const ModemMessages&) = delete;

    /// The picture may have changed.
    void changed();

    std::uint64_t count() const { return _count; }
    /// The latest one; null before the first.
    std::shared_ptr<const ByteBuffer> latest() const { return _latest; }
    Time time() const { return _time; }

private:
    void make(bool isOverdue);
    void after(std::chrono::nanoseconds delay, void (ModemMessages::*member)());
    void lookForChange();
    void endPause();

    Setup _setup;
    std::shared_ptr<const ByteBuffer> _latest;
    Time _time;
    std::uint64_t _count = 0;
    bool _isLooking = false; ///< a look for a change is due
    bool _isPausing = false; ///< since the latest message
    bool _hasChanged = false;
    std::shared_ptr<ModemMessages*> _alive; ///< held weakly by blocks
};

} // namespace pallax
