#pragma once

#include "tests/ui/terminal/GridSupport.h"
#include "tests/ui/terminal/StageData.h"
#include "tests/ui/terminal/TerminalStage.h"

#include <gtest/gtest.h>

namespace pallax::terminal {

/// The stage, and how what is on it looks.
class StageFixture : public testing::Test {
protected:
    /// One section of these entries, opened.
    void openSection(const Dictionary& section, const char* name = "Section") {
        stage.tick(Dictionary{{name, section}});
        stage.press(Key::Enter);
        ASSERT_EQ(stage.depth(), 2U);
    }
    Grid draw() { return stage.frontEnd.draw(); }
    Style styleAt(int x, int y) { return draw().at(x, y).style; }

    TerminalStage stage;
};

} // namespace pallax::terminal
