#pragma once

#include <chrono>
#include <functional>

namespace pallax {

/// The main dispatch queue. Blocks run one at a time, on the main thread, in the order in which
/// they were posted or fell due. Exceptions propagate to the caller that runs the queue.
class MainQueue {
public:
    using Block = std::function<void()>;

    virtual ~MainQueue() = default;
    virtual void async(Block block) = 0;
    virtual void after(std::chrono::nanoseconds delay, Block block) = 0;
};

} // namespace pallax
