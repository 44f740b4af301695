#pragma once

#include <gtest/gtest.h>

namespace pallax::doubles {

/// Starts an X server without a screen for this process, once, and connects the toolkit to it:
/// without animations, with settings and accessibility of its own. False where there is no Xvfb.
bool openXDisplay();

} // namespace pallax::doubles

namespace pallax::gtk {

/// Tests with widgets; skipped where there is no display for them.
class DisplayTest : public testing::Test {
protected:
    void SetUp() override {
        if (!doubles::openXDisplay()) {
            GTEST_SKIP() << "Xvfb is not installed";
        }
    }
};

} // namespace pallax::gtk
