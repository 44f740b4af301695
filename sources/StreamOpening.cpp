#include "sources/StreamOpening.h"

#include "text/Format.h"

#include <condition_variable>
#include <mutex>
#include <thread>

namespace pallax {

namespace {

using SteadyClock = std::chrono::steady_clock;

/// Watches the time while another thread waits.
class Watch {
public:
    explicit Watch(const StreamOpening& opening) : _opening(opening), _thread([this] { look(); }) {}
    ~Watch() { end(); }
    Watch(const Watch&) = delete;
    Watch& operator=(const Watch&) = delete;

    /// Ends the watch. True if the wait was reported.
    bool end() {
        {
            const std::lock_guard lock(_mutex);
            _isOver = true;
        }
        _over.notify_one();
        if (_thread.joinable()) {
            _thread.join();
        }
        return _hasReported;
    }

private:
    void look() {
        std::unique_lock lock(_mutex);
        if (!_over.wait_for(lock, _opening.patience, [this] { return _isOver; })) {
            _hasReported = true;
            _opening.report(
                formatText("The stream has stalled: no header for %lld s.",
                           {std::chrono::floor<std::chrono::seconds>(_opening.patience).count()}));
        }
    }

    const StreamOpening& _opening;
    std::mutex _mutex;
    std::condition_variable _over;
    bool _isOver = false;
    bool _hasReported = false;
    std::thread _thread; // declared last, because it uses the others
};

} // namespace

StreamOpening::Opened openStream(const StreamOpening& opening) {
    const SteadyClock::time_point begun = SteadyClock::now();
    Watch watch(opening);
    auto opened = opening.open();
    const bool hasStalled = watch.end();
    if (hasStalled && opened) {
        opening.report(formatText(
            "The stream continues after %lld s.",
            {std::chrono::floor<std::chrono::seconds>(SteadyClock::now() - begun).count()}));
    }
    return opened;
}

} // namespace pallax
