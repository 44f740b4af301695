#pragma once

#include "tests/timeline/TimelineFixture.h"

#include <memory>

namespace pallax::terminal {

/// The timeline of a simulated drive.
class SampleTimeline {
public:
    explicit SampleTimeline(const char* technology = "lte",
                            std::chrono::seconds duration = std::chrono::seconds(60))
        : recorded(technology) {
        recorded.drive(7, duration);
        timeline = recorded.indexed();
    }

    TimelineFixture recorded;
    std::unique_ptr<Timeline> timeline;
};

} // namespace pallax::terminal
