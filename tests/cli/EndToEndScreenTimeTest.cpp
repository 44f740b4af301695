#include "tests/cli/EndToEndScreen.h"

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

TEST_F(EndToEndScreen, TimeIsHeldSteppedAndLeftWhileTheScreenStays) {
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("^");
    EXPECT_TRUE(terminal.shows("held, 2 min behind"));
    EXPECT_TRUE(terminal.shows("22:13:20"));
    terminal.type(":22:14\r");
    EXPECT_TRUE(terminal.shows("22:14:00"));
    terminal.type(":25:99\r");
    EXPECT_TRUE(terminal.shows("25:99"));
    terminal.type("$");
    EXPECT_TRUE(terminal.showsNoMore("held"));
    EXPECT_TRUE(terminal.shows("End of the recording"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
    expectNothingLeft();
}

TEST_F(EndToEndScreen, WhatIsHeldOfARecordingThatHasGrownSaysSo) {
    const std::string path = world.path("grows.pcap");
    std::filesystem::copy_file(lteDrive(), path);
    PallaxTerminal terminal(world, {path, "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    std::ofstream(path, std::ios::app | std::ios::binary) << "more";
    terminal.type(" ");
    EXPECT_TRUE(terminal.shows("has grown while it was read."));
    terminal.type(",");
    EXPECT_TRUE(terminal.showsNoMore("has grown while it was read."));
    EXPECT_TRUE(terminal.shows("held"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

} // namespace
} // namespace pallax
