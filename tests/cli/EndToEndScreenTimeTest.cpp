#include "tests/cli/EndToEndScreen.h"

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

/// As a terminal reports the mouse: button and motion, column, row, and whether it is pressed.
std::string mouse(int what, int column, int row, char kind) {
    return "\x1b[<" + std::to_string(what) + ";" + std::to_string(column) + ";" +
           std::to_string(row) + kind;
}

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

TEST_F(EndToEndScreen, TheMouseDragsTheHeldInstantAlongTheBar) {
    constexpr int kMoved = 0x20;
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("^");
    ASSERT_TRUE(terminal.shows("22:13:20"));
    std::string flood = mouse(0, 3, 24, 'M');
    for (int column = 0; column < 200; ++column) {
        flood += mouse(kMoved, 3 + column % 8, 24, 'M');
    }
    const std::size_t before = terminal.bytes().size();
    terminal.type(flood + mouse(kMoved, 12, 24, 'M'));
    EXPECT_TRUE(terminal.shows("22:14:17"));
    EXPECT_LT(terminal.bytes().size() - before, 10'000U); // positions in between are not drawn
    terminal.type(mouse(kMoved, 3, 10, 'M'));
    EXPECT_TRUE(terminal.shows("22:13:20"));
    terminal.type(mouse(0, 3, 10, 'm') + mouse(kMoved, 12, 24, 'M') + "$");
    EXPECT_TRUE(terminal.showsNoMore("held"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
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

TEST_F(EndToEndScreen, WhatIsAppendedToARecordingJoinsItsTimeline) {
    constexpr std::size_t kPcapHeader = 24;
    const std::string path = world.path("grows.pcap");
    const std::string drive = contentOf(lteDrive());
    std::ofstream(path, std::ios::binary) << drive;
    PallaxTerminal terminal(world, {path, "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("^e");
    ASSERT_TRUE(terminal.shows("22:15:19"));
    const auto events = [&terminal] {
        const std::string title = terminal.screen().text();
        const std::size_t end = title.find(" events");
        return std::stoi(title.substr(title.rfind(' ', end - 1) + 1));
    };
    (void)terminal.settled();
    const int before = events();
    std::ofstream(path, std::ios::binary | std::ios::app) << drive.substr(kPcapHeader);
    EXPECT_TRUE(doubles::eventually([&] {
        (void)terminal.settled();
        return events() > before;
    }));
    EXPECT_EQ(terminal.screen().text().find("has grown"), std::string::npos);
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

} // namespace
} // namespace pallax
