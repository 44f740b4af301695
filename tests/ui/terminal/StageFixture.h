#pragma once

#include "tests/ui/drawing/GridSupport.h"
#include "tests/ui/terminal/StageData.h"
#include "tests/ui/terminal/TerminalStage.h"

#include <gtest/gtest.h>

namespace pallax::terminal {

/// The stage, with access to the styles on it.
class StageFixture : public testing::Test {
protected:
    /// Opens a section with these entries.
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
