#pragma once

#include "host/BoundedJournal.h"
#include "live/IndexingSlices.h"
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
        IndexingSlices::SteadyNow steadyNow = std::chrono::steady_clock::now;
        /// Called when a timeline has been replaced by one of another technology.
        std::function<void()> replaced = [] {};
    };

    explicit LiveTimeline(Setup setup)
        : _setup(std::move(setup)), _slices(_setup.queue, _setup.indexed, _setup.steadyNow) {}

    /// A packet of another technology than the one before begins a new timeline. Exceptions of the
    /// resources pass through.
    void add(const RecordedTechnology& technology, Time stamp, Bytes packet);
    /// Drops all packets.
    void forget();
    /// Indexes what is left.
    void finish();

    /// Null before the first packet.
    Timeline* timeline() { return _timeline.get(); }
    /// Sentences about what is missing; empty if all is well.
    std::vector<std::string> notes() const;

private:
    void begin(const RecordedTechnology& technology);

    Setup _setup;
    const RecordedTechnology* _technology = nullptr;
    std::unique_ptr<BoundedJournal> _journal; // outlives the timeline
    std::unique_ptr<Timeline> _timeline;
    IndexingSlices _slices;
};

} // namespace pallax
