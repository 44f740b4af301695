#pragma once

#include "timeline/Timeline.h"

#include <chrono>
#include <functional>
#include <memory>
#include <utility>

namespace pallax {

class MainQueue;

/// Indexes a timeline in slices, between the other blocks of the main queue.
class IndexingSlices {
public:
    /// A slice ends after so much time, at the next packet at which the timeline asks.
    static constexpr std::chrono::milliseconds kLongest{5};
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    /// `indexed` is called after a slice. The queue must outlive the slices.
    IndexingSlices(MainQueue& queue, std::function<void(Timeline&)> indexed,
                   SteadyNow steadyNow = std::chrono::steady_clock::now)
        : _queue(queue), _indexed(std::move(indexed)), _steadyNow(std::move(steadyNow)) {}

    /// Indexes what the journal has, soon. The timeline must live until `stop`.
    void start(Timeline& timeline);
    void stop() { _next.reset(); }

private:
    void indexSlice(Timeline& timeline);

    MainQueue& _queue;
    std::function<void(Timeline&)> _indexed;
    SteadyNow _steadyNow;
    std::shared_ptr<IndexingSlices*> _next; ///< exists while the next slice is on the queue
};

} // namespace pallax
