#include "tests/cli/EndToEndScreen.h"

#include <fstream>

namespace pallax {
namespace {

TEST_F(EndToEndScreen, AValuesPageTellsWhereItWasRead) {
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

/// Which characters the curve on a value's page is drawn with.
class EndToEndCurves : public EndToEndScreen {
protected:
    std::string charactersOfCurves(const std::string& setting, const std::string& terminalType) {
        std::ofstream(world.path("config/pallax/pallax.conf")) << setting << "\n";
        PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {.type = terminalType});
        EXPECT_TRUE(terminal.shows("End of the recording"));
        terminal.type("/cell meas\r\r");
        EXPECT_TRUE(terminal.shows("Pallax › Serving Cell Measurements"));
        terminal.type("/measured rsrp\r\r");
        EXPECT_TRUE(terminal.shows("raw 182"));
        const std::string screen = terminal.settled();
        terminal.type("qqqq"); // page, pane, filter, program
        EXPECT_EQ(terminal.wait(), 0);
        std::string kinds;
        for (const char* lead : {"\xE2\xA1", "\xE2\xA2", "\xE2\xA3"}) { // most of braille
            if (screen.find(lead) != std::string::npos) {
                kinds = "braille";
            }
        }
        if (screen.find("▀") != std::string::npos || screen.find("▄") != std::string::npos) {
            kinds += "blocks";
        }
        return kinds.empty() && screen.find("*") != std::string::npos ? "ascii" : kinds;
    }
};

TEST_F(EndToEndCurves, AreOfWhatTheTerminalHasUnlessTheSettingsSayOtherwise) {
    EXPECT_EQ(charactersOfCurves("", "xterm-256color"), "braille");
    EXPECT_EQ(charactersOfCurves("", "linux"), "blocks");
    EXPECT_EQ(charactersOfCurves("curves = braille", "linux"), "braille");
    EXPECT_EQ(charactersOfCurves("curves = blocks", "xterm-256color"), "blocks");
    EXPECT_EQ(charactersOfCurves("curves = ascii", "xterm-256color"), "ascii");
}

} // namespace
} // namespace pallax
