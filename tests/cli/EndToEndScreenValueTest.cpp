#include "tests/cli/EndToEndScreen.h"

#include <fstream>

namespace pallax {
namespace {

TEST_F(EndToEndScreen, AValuesPageTellsWhereItWasRead) {
    std::ofstream(world.path("config/pallax/pallax.conf")) << "curves = blocks\n";
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/cell meas\r\r");
    ASSERT_TRUE(terminal.shows("Pallax › Serving Cell Measurements"));
    terminal.type("/measured rsrp\r\r");
    ASSERT_TRUE(terminal.shows("Pallax › Serving Cell Measurements › Measured RSRP"));
    EXPECT_TRUE(terminal.shows("-94.50 dBm  excellent"));
    EXPECT_TRUE(terminal.shows("Reference signal received power of the serving cell"));
    EXPECT_TRUE(terminal.shows("raw 182"));
    EXPECT_TRUE(terminal.shows("log code 0xB17F"));
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.shows("▌Measured RSRP"));
    terminal.type("vV");
    EXPECT_TRUE(terminal.shows("-94.50 dBm  Measured RSRP, Serving Cell Measurements"));
    terminal.type("Vqqq");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
    EXPECT_EQ(terminal.screen().unknown(), "");
}

} // namespace
} // namespace pallax
