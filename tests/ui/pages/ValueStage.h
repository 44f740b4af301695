#pragma once

#include "tests/timeline/TimelineFixture.h"
#include "tests/ui/terminal/StageFixture.h"

#include <memory>
#include <string>

namespace pallax::terminal {

/// A simulated drive with its timeline, made once for all tests.
class RecordedDrive : public TimelineFixture {
public:
    explicit RecordedDrive(const char* technologyName, std::chrono::seconds duration)
        : TimelineFixture(technologyName) {
        drive(7, duration);
        timeline = indexed(Timeline::Limits());
    }
    static RecordedDrive& lte() {
        static RecordedDrive drive("lte", std::chrono::minutes(7));
        return drive;
    }

    std::unique_ptr<Timeline> timeline;
};

/// The stage with panes and values at an instant of a drive.
class ValueStage : public testing::Test {
protected:
    void show(TerminalStage& on, std::uint64_t instant) {
        Timeline& timeline = *drive.timeline;
        on.moment = {&timeline, instant};
        on.displayTime = {*timeOf(timeline, instant) + std::chrono::seconds(1), {}};
        on.tick(timeline.displayAt(instant));
    }
    void show(std::uint64_t instant) { show(stage, instant); }
    /// Opens the pane of that name and puts the cursor on that row.
    static void select(TerminalStage& on, const std::string& pane, const std::string& row) {
        for (const std::string& name : {pane, row}) {
            on.press(Key::Home);
            for (int tries = 0; on.cursorName() != name && tries < 100; ++tries) {
                on.press(Key::Down);
            }
            ASSERT_EQ(on.cursorName(), name);
            if (name == pane) {
                on.press(Key::Enter);
            }
        }
    }
    void select(const std::string& pane, const std::string& row) { select(stage, pane, row); }
    Grid draw() { return stage.frontEnd.draw(); }
    bool shows(const std::string& text) { return stage.screen().find(text) != std::string::npos; }
    std::uint64_t last() const { return drive.timeline->packets(); }

    RecordedDrive& drive = RecordedDrive::lte();
    TerminalStage stage;
};

} // namespace pallax::terminal
