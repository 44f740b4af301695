#pragma once

#include "host/BoundedJournal.h"
#include "timeline/Timeline.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace pallax {

class MainQueue;

/// The packets of a live channel as a timeline that grows. They are kept in a bounded journal and
/// indexed in slices, between the other blocks of the main queue.
class LiveTimeline {
public:
    /// A slice ends after so much time, at the next packet at which the timeline asks.
    static constexpr std::chrono::milliseconds kLongestSlice{5};
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    /// All references must outlive the timeline.
    struct Setup {
        MainQueue& queue;
        const Resources& resources;
        const Bundle& bundle;
        std::span<const Technology> technologies;
        BoundedJournal::Limits journal = {};
        /// Receives the sentence that the modem has another technology.
        std::function<void(const std::string& sentence)> report;
        /// Called after a slice.
        std::function<void(Timeline& timeline)> indexed = [](Timeline&) {};
        SteadyNow steadyNow = std::chrono::steady_clock::now; ///< measures slices
    };

    explicit LiveTimeline(Setup setup) : _setup(std::move(setup)) {}

    /// A packet of another technology than the one before begins a new timeline. Exceptions of the
    /// resources pass through.
    void add(const RecordedTechnology& technology, Time stamp, Bytes packet);
    /// Indexes what is left.
    void finish();

    /// Null before the first packet.
    Timeline* timeline() { return _timeline.get(); }
    /// Sentences about what is missing; empty if all is well.
    std::vector<std::string> notes() const;

private:
    void begin(const RecordedTechnology& technology);
    void indexLater();
    void indexSlice();

    Setup _setup;
    const RecordedTechnology* _technology = nullptr;
    std::unique_ptr<BoundedJournal> _journal; // outlives the timeline
    std::unique_ptr<Timeline> _timeline;
    std::shared_ptr<LiveTimeline*> _slice; ///< exists while the next slice is on the queue
};

} // namespace pallax
