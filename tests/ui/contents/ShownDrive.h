#pragma once

#include "tests/timeline/TimelineFixture.h"
#include "ui/contents/ShownValues.h"

#include <chrono>
#include <memory>

namespace pallax {

/// The values of a simulated drive, as pages show them.
class ShownDrive {
public:
    explicit ShownDrive(std::chrono::seconds duration = std::chrono::seconds(60)) {
        _fixture.drive(7, duration);
        timeline = _fixture.indexed();
        moment = {timeline.get(), timeline->packets()};
    }

    NetworkNames names;
    std::unique_ptr<Timeline> timeline;
    Moment moment;
    DisplayTime displayTime;
    ShownValues shown{{[this] { return moment; }, [] { return nullptr; },
                       [this]() -> const NetworkNames& { return names; },
                       [this] { return displayTime; }}};

private:
    TimelineFixture _fixture{"lte"};
};

} // namespace pallax
