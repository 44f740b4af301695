#pragma once

#include "platform/RunLoop.h"
#include "tests/doubles/SteppedQueue.h"

#include <utility>

namespace pallax::doubles {

/// A loop on a stepped queue, whose time passes while the loop runs.
class SteppedLoop final : public RunLoop {
public:
    explicit SteppedLoop(SteppedQueue& queue) : _queue(queue) {}

    void run() override {
        while (runReady()) {
            _queue.advance(kStep);
        }
    }
    bool runReady() override {
        while (!_isStopped && _queue.step()) {
        }
        return !std::exchange(_isStopped, false);
    }
    void stop() override { _isStopped = true; }

private:
    static constexpr std::chrono::milliseconds kStep{10};

    SteppedQueue& _queue;
    bool _isStopped = false;
};

} // namespace pallax::doubles
