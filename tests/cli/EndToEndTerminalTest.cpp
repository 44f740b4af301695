#include "tests/cli/EndToEndScreen.h"

#include <algorithm>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <thread>

namespace pallax {
namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

/// The terminal behaviour that users expect of a program.
class EndToEndTerminal : public EndToEndScreen {};

TEST_F(EndToEndTerminal, ResizingIsSafeAtAnyMoment) {
    PallaxTerminal terminal(world, {changing(), "--speed", "4"}, {});
    ASSERT_TRUE(terminal.shows("Process CO"));
    terminal.resize(20, 5);
    EXPECT_TRUE(terminal.shows("▌"));
    terminal.resize(13, 4);
    EXPECT_TRUE(terminal.shows("Pallax needs\n20x5"));
    terminal.resize(1, 1);
    terminal.resize(100, 30);
    EXPECT_TRUE(terminal.shows("? help"));
    const std::string screen = terminal.settled();
    EXPECT_EQ(std::count(screen.begin(), screen.end(), '\n'), 30);
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

/// Whether the latest request for reports of the mouse came after the latest that ends them.
bool reportsMouse(const std::string& bytes) {
    const auto last = [&bytes](const char* request) {
        const std::size_t at = bytes.rfind(request);
        return at == std::string::npos ? -1 : static_cast<std::ptrdiff_t>(at);
    };
    return last("\x1b[?1002h") > last("\x1b[?1002l");
}

TEST_F(EndToEndTerminal, ItIsSuspendedAndComesBack) {
    PallaxTerminal terminal(world, {"--norc", "--noprofile", "-i"}, {.program = "/bin/bash"});
    ASSERT_TRUE(terminal.shows("$"));
    terminal.type(doubles::programPath() + " " + changing() + " --speed 4\r");
    ASSERT_TRUE(terminal.shows("Process CO")); // the rest may follow later
    terminal.type("\x1a");
    ASSERT_TRUE(terminal.shows("Stopped"));
    EXPECT_FALSE(reportsMouse(terminal.bytes()));
    EXPECT_FALSE(terminal.screen().isOnOtherScreen());
    (void)terminal.settled(); // the shell drops keys typed before its prompt
    terminal.type("fg\r");
    EXPECT_TRUE(terminal.showsNoMore("Stopped"));
    EXPECT_TRUE(terminal.shows("Process CO"));
    EXPECT_TRUE(terminal.screen().isOnOtherScreen());
    EXPECT_TRUE(doubles::eventually([&terminal] {
        (void)terminal.settled();
        return reportsMouse(terminal.bytes());
    }));
    terminal.type("q");
    EXPECT_TRUE(terminal.shows("$"));
    terminal.type("exit\r");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndTerminal, TheShellsTerminalStaysBlocking) {
    const std::string command = doubles::programPath() + " " + brief() +
                                " --speed max; "
                                "sed -n 's/^flags:/flags/p' /proc/self/fdinfo/0";
    PallaxTerminal terminal(world, {"-c", command}, {.program = "/bin/sh"});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    const std::string screen = terminal.screen().text();
    const std::size_t at = screen.find("flags");
    ASSERT_NE(at, std::string::npos) << screen;
    const long flags = std::strtol(screen.c_str() + at + 5, nullptr, 8);
    EXPECT_EQ(flags & O_NONBLOCK, 0) << screen;
}

TEST_F(EndToEndTerminal, EverySignalThatEndsItLeavesTheTerminalRestoredAndThePreferenceWritten) {
    for (const int number : {SIGTERM, SIGINT, SIGHUP}) {
        std::filesystem::remove_all(world.path("config/pallax/preferences"));
        PallaxTerminal terminal(world, {changing(), "--speed", "4"}, {});
        ASSERT_TRUE(terminal.shows("Process CO"));
        terminal.signal(number);
        EXPECT_EQ(terminal.wait(), 0) << number;
        EXPECT_TRUE(terminal.isRestored()) << number;
        expectHomeScreenPreference();
        expectNothingLeft();
    }
}

TEST_F(EndToEndTerminal, ControlCEndsIt) {
    PallaxTerminal terminal(world, {changing(), "--speed", "4"}, {});
    ASSERT_TRUE(terminal.shows("Process CO"));
    terminal.type("\x03");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
    expectHomeScreenPreference();
}

TEST_F(EndToEndTerminal, ACrashLeavesTheTerminalRestored) {
    for (const int number : {SIGSEGV, SIGABRT, SIGQUIT}) {
        PallaxTerminal terminal(world, {changing(), "--speed", "4"}, {});
        ASSERT_TRUE(terminal.shows("Process CO"));
        terminal.signal(number);
        EXPECT_EQ(terminal.wait(), -number);
        EXPECT_TRUE(terminal.isRestored()) << number;
    }
}

TEST_F(EndToEndTerminal, AFatalRecordRestoresTheTerminalAndGivesOneSentence) {
    const std::string recording = record("fatal.pcap", {{milliseconds(0), registration(0)},
                                                        {seconds(5), registration(2)},
                                                        {seconds(6), unreadableSimFiles()}});
    PallaxTerminal terminal(world, {recording, "--speed", "4"}, {});
    ASSERT_TRUE(terminal.shows("Process CO"));
    EXPECT_EQ(terminal.wait(), 70);
    EXPECT_TRUE(terminal.isRestored());
    EXPECT_TRUE(terminal.shows("pallax: packet 3 (log code 0xFF0000): "));
    expectHomeScreenPreference();
}

TEST_F(EndToEndTerminal, ColoursFollowOptionAndEnvironment) {
    const auto hasColours = [this](std::vector<std::string> options, const std::string& type,
                                   std::vector<std::string> environment) {
        world.environment = std::move(environment);
        std::vector<std::string> arguments{brief(), "--speed", "max"};
        arguments.insert(arguments.end(), options.begin(), options.end());
        PallaxTerminal terminal(world, arguments, {.type = type});
        EXPECT_TRUE(terminal.shows("End of the recording"));
        terminal.type("q");
        EXPECT_EQ(terminal.wait(), 0);
        return terminal.bytes().find("\x1b[36m") != std::string::npos;
    };
    EXPECT_TRUE(hasColours({}, "xterm-256color", {}));
    EXPECT_TRUE(hasColours({}, "xterm", {}));
    EXPECT_FALSE(hasColours({}, "vt100", {}));
    EXPECT_FALSE(hasColours({}, "xterm-256color", {"NO_COLOR=1"}));
    EXPECT_TRUE(hasColours({}, "xterm-256color", {"NO_COLOR="}));
    EXPECT_TRUE(hasColours({"--color=always"}, "xterm-256color", {"NO_COLOR=1"}));
    EXPECT_FALSE(hasColours({"--color=never"}, "xterm-256color", {}));
}

TEST_F(EndToEndTerminal, QualityHasTheColoursThatTheTerminalHas) {
    // A terminal type with direct colour, which the system may lack.
    std::ofstream(world.path("direct.src"))
        << "pallax-direct|for a test, RGB, colors#0x1000000, pairs#0x7FFF, "
           "setaf=\\E[%?%p1%{8}%<%t3%p1%d%e38\\:2\\:%p1%{65536}%/%d\\:"
           "%p1%{256}%/%{255}%&%d\\:%p1%{255}%&%d%;m, use=xterm-256color,\n";
    ASSERT_EQ(std::system(
                  ("tic -x -o " + world.path("terminfo") + " " + world.path("direct.src")).c_str()),
              0);
    const auto colors = [this](const std::string& type, std::vector<std::string> options,
                               const std::string& variable) {
        world.environment = {"TERMINFO=" + world.path("terminfo"), variable};
        options.insert(options.begin(), {lteDrive(), "--speed", "max"});
        PallaxTerminal terminal(world, options, {.type = type});
        EXPECT_TRUE(terminal.shows("End of the recording"));
        terminal.type("o");
        EXPECT_TRUE(terminal.shows("RSRQ   -12.62 dB  good"));
        (void)terminal.settled();
        const std::string found = terminal.screen().colorOf("excellent") + " " +
                                  terminal.screen().colorOf("good") + " " +
                                  terminal.screen().colorOf("-12.62 dB");
        EXPECT_EQ(terminal.screen().unknown(), "") << type;
        terminal.type("qq");
        EXPECT_EQ(terminal.wait(), 0);
        return found;
    };
    EXPECT_EQ(colors("xterm-256color", {}, "NO_COLOR="), "29 32 default");
    EXPECT_EQ(colors("xterm", {}, "NO_COLOR="), "2 6 default");
    EXPECT_EQ(colors("pallax-direct", {}, "NO_COLOR="), "#00875f #0087d7 default");
    EXPECT_EQ(colors("vt100", {}, "NO_COLOR="), "default default default");
    EXPECT_EQ(colors("xterm-256color", {}, "NO_COLOR=1"), "default default default");
    EXPECT_EQ(colors("xterm-256color", {"--color=never"}, "NO_COLOR="), "default default default");
}

TEST_F(EndToEndTerminal, ALocaleThatIsNotUtf8GetsAsciiMarks) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {.locale = "C"});
    ASSERT_TRUE(terminal.shows(">Serving PLMN"));
    EXPECT_TRUE(terminal.shows("End of the recording"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(std::all_of(terminal.bytes().begin(), terminal.bytes().end(),
                            [](char byte) { return byte >= 0; }));
}

TEST_F(EndToEndTerminal, ADumbTerminalGetsThePrintedTree) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {.rows = 60, .type = "dumb"});
    EXPECT_TRUE(terminal.shows("== 2023-11-14 22:13:22 +0000\nServing PLMN\n"));
    EXPECT_TRUE(terminal.shows("\nProcess CO\n  MM Service State: REG_STATE_REGISTERING\n"));
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_EQ(terminal.bytes().find('\x1b'), std::string::npos);
}

TEST_F(EndToEndTerminal, AnUnknownTerminalTypeGivesOneSentence) {
    PallaxTerminal terminal(world, {brief()}, {.type = "no-such-terminal"});
    EXPECT_TRUE(terminal.shows("pallax: The terminal type \"no-such-terminal\" (TERM) is unknown; "
                               "--print needs no\n terminal.\n"));
    EXPECT_EQ(terminal.wait(), 1);
}

TEST_F(EndToEndTerminal, KeysThatTheTerminalSendsDifferentlyFromItsTypeAreKnown) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {.type = "vt100"});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("jj");
    ASSERT_TRUE(terminal.shows("▌Process CO"));
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows("Pallax › Process CO"));
    terminal.type("\x1b[6~\x1b[1~\x1b[4~"); // page down, Home, End: none goes back
    terminal.type("\x1b[200~\x1b[I");       // start of a paste and a focus event: not keys
    terminal.settled();
    EXPECT_TRUE(terminal.shows("Pallax › Process CO"));
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.showsNoMore("Pallax ›"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndTerminal, AnArrowThatComesInTwoPartsIsNoEscape) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows("Pallax › Serving PLMN"));
    terminal.type("\x1b");
    std::this_thread::sleep_for(milliseconds(50));
    terminal.type("OB");
    terminal.settled();
    EXPECT_TRUE(terminal.shows("Pallax › Serving PLMN"));
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndTerminal, InAPlainLocaleADescriptionIsStillUtf8) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {.locale = "C"});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("s");
    ASSERT_TRUE(terminal.shows("Save snapshot"));
    terminal.type("über x\r\r");
    ASSERT_TRUE(terminal.shows("Saved "));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    ASSERT_EQ(filesIn(snapshots).size(), 1U);
    EXPECT_NE(contentOf(filesIn(snapshots)[0]).find("<string>über x</string>"), std::string::npos);
}

TEST_F(EndToEndTerminal, ATerminalIsNoRecording) {
    PallaxTerminal terminal(world, {"-"}, {});
    EXPECT_TRUE(terminal.shows("pallax: Standard input is a terminal; pipe a recording into it."));
    EXPECT_EQ(terminal.wait(), 2);
}

TEST_F(EndToEndTerminal, ATickClearsNothing) {
    PallaxTerminal terminal(world, {changing(), "--speed", "8"}, {});
    ASSERT_TRUE(terminal.shows("Process CO"));
    terminal.type("/process co\r\r");
    ASSERT_TRUE(terminal.shows("REG_STATE_INACTIVE"));
    const std::size_t before = terminal.bytes().size();
    EXPECT_TRUE(terminal.shows("REG_STATE_REGISTERING"));
    EXPECT_TRUE(terminal.shows("REG_STATE_INACTIVE"));
    const std::string since = terminal.bytes().substr(before);
    EXPECT_EQ(since.find("\x1b[2J"), std::string::npos);
    EXPECT_EQ(since.find("\x1b[H"), std::string::npos);
    EXPECT_LT(since.size(), 2000U) << "only changes are drawn";
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndTerminal, KeysComeFromTheTerminalWhenStandardInputIsTheRecording) {
    const std::string command = doubles::programPath() + " - --speed max < " + brief();
    PallaxTerminal terminal(world, {"-c", command}, {.program = "/bin/sh"});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("\r");
    EXPECT_TRUE(terminal.shows("Pallax › "));
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndTerminal, LogLinesOnTheScreenAreRefused) {
    PallaxTerminal terminal(world, {brief(), "--log-level", "4"}, {});
    EXPECT_TRUE(terminal.shows("pallax: --log-level writes to standard error, which is the "
                               "screen here: send it\nto a file (2>FILE), or add --print.\n"));
    EXPECT_EQ(terminal.wait(), 2);
}

} // namespace
} // namespace pallax
