#include "platform/PropertyListCodec.h"
#include "tests/cli/EndToEnd.h"
#include "tests/cli/PallaxTerminal.h"
#include "tests/doubles/RuntimeFolder.h"

#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <thread>

namespace pallax {
namespace {

using doubles::contentOf;
using doubles::noChildLeft;
using doubles::PallaxTerminal;
using std::chrono::milliseconds;
using std::chrono::seconds;

constexpr const char* kEscape = "\x1b";

/// The application in a pseudo-terminal.
class EndToEndScreen : public EndToEnd {
protected:
    EndToEndScreen() {
        std::filesystem::create_directories(world.path("config/pallax"));
        std::filesystem::create_directories(snapshots);
        configure(snapshots);
    }

    void configure(const std::string& directory) const {
        std::ofstream(world.path("config/pallax/pallax.conf"))
            << "snapshot-directory = " << directory
            << "\nsave-button-marker = " << world.path("config") << "\n";
    }

    /// Both states of the registration in turn, for a minute.
    std::string changing() const {
        std::vector<Packet> packets;
        for (int count = 0; count < 60; ++count) {
            packets.emplace_back(seconds(count), registration(count / 4 % 2 == 0 ? 0 : 2));
        }
        return record("changing.pcap", packets);
    }

    /// Two packets, which are soon over.
    std::string brief() const {
        return record("brief.pcap",
                      {{milliseconds(0), registration(0)}, {milliseconds(100), registration(2)}});
    }

    std::string lteDrive() const {
        return std::string(PALLAX_SOURCE_DIR) + "/samples/lte-drive.pcap";
    }

    std::vector<std::string> filesIn(const std::string& folder) const {
        std::vector<std::string> files;
        for (const auto& entry : std::filesystem::directory_iterator(folder)) {
            files.push_back(entry.path().string());
        }
        return files;
    }

    /// What the application leaves at every exit.
    void expectHomeScreenPreference() const {
        const std::string file = world.path("config/pallax/preferences/com.norvane.plinthe.plist");
        EXPECT_NE(contentOf(file).find("<key>PLShowGSMRSSI</key>\n\t<false/>"), std::string::npos)
            << contentOf(file);
    }

    void expectNothingLeft() const {
        EXPECT_TRUE(noChildLeft());
        EXPECT_TRUE(doubles::eventually([this] { return world.sockets().empty(); }));
    }

    std::string snapshots = world.path("snapshots");
};

TEST_F(EndToEndScreen, PanesOpenThreeLevelsDeepAndCloseAgain) {
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/list\r");
    ASSERT_TRUE(terminal.shows("Neighbor Cells List"));
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows("Pallax › Neighbor Cells List"));
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows("Pallax › Neighbor Cells List › 0"));
    EXPECT_TRUE(terminal.shows("▌Physical Cell ID "));
    terminal.type("h");
    EXPECT_TRUE(terminal.showsNoMore("› 0"));
    terminal.type("\x7f");
    EXPECT_TRUE(terminal.showsNoMore("Pallax › "));
    EXPECT_TRUE(terminal.shows("of 11")); // the filter of the first pane is still there
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.shows("PDP Context Info"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
    EXPECT_EQ(terminal.screen().unknown(), "");
    expectHomeScreenPreference();
    expectNothingLeft();
}

TEST_F(EndToEndScreen, AValueThatChangesWhileOneLooksIsMarkedForOneTick) {
    PallaxTerminal terminal(world, {changing(), "--speed", "4"}, {});
    ASSERT_TRUE(terminal.shows("Process CO"));
    terminal.type("/process co\r\r");
    ASSERT_TRUE(terminal.shows("Pallax › Process CO"));
    EXPECT_TRUE(terminal.shows("REG_STATE_INACTIVE *"));
    EXPECT_TRUE(terminal.showsNoMore("REG_STATE_INACTIVE *"));
    EXPECT_TRUE(terminal.shows("REG_STATE_INACTIVE"));
    EXPECT_TRUE(terminal.shows("REG_STATE_REGISTERING *"));
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, TheFilterKeepsWhatMatchesAndEscapeClearsIt) {
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/neighb");
    EXPECT_TRUE(terminal.shows("3 of 11"));
    EXPECT_TRUE(terminal.shows("/ neighb"));
    EXPECT_TRUE(terminal.showsNoMore("SIM Info"));
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.shows("SIM Info"));
    EXPECT_TRUE(terminal.showsNoMore("of 11"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, ASavedSnapshotHoldsWhatWasOnTheScreen) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/process co\r\r");
    ASSERT_TRUE(terminal.shows("REG_STATE_REGISTERING"));
    terminal.type("s");
    ASSERT_TRUE(terminal.shows("✓ Snapshot (2023-11-14 22:13:22 +0000)"));
    EXPECT_TRUE(terminal.shows("✓ DLF binary ("));
    terminal.type("tunnel entrance, über\r\r");
    ASSERT_TRUE(terminal.shows("Saved " + snapshots));
    EXPECT_TRUE(terminal.showsNoMore("Save snapshot"));
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);

    const auto files = filesIn(snapshots);
    ASSERT_EQ(files.size(), 1U);
    EXPECT_TRUE(std::filesystem::path(files[0]).filename().string().starts_with("PallaxSnapshot-"));
    const std::string text = contentOf(files[0]);
    const ByteBuffer bytes(text.begin(), text.end());
    const auto snapshot = parsePropertyList(bytes);
    ASSERT_TRUE(snapshot);
    const DictionaryRef root = snapshot->dictionary();
    EXPECT_EQ(root->find("Description")->string(), "tunnel entrance, über");
    const ArrayRef data = root->find("Data")->array();
    ASSERT_EQ(data->size(), 2U); // one rebuild, and the DLF
    const DictionaryRef display = (*data)[0].dictionary()->find("Display")->dictionary();
    EXPECT_EQ(display->find("Process CO")->dictionary()->find("MM Service State")->string(),
              "REG_STATE_REGISTERING");
}

TEST_F(EndToEndScreen, CancelWritesNothing) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("s");
    ASSERT_TRUE(terminal.shows("Save snapshot"));
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.showsNoMore("Save snapshot"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(filesIn(snapshots).empty());
}

TEST_F(EndToEndScreen, AMissingSnapshotDirectoryGivesAnAlertAndTheViewerGoesOn) {
    configure(world.path("nowhere"));
    const std::string command = std::string(PALLAX_PROGRAM) + " " + brief() +
                                " --speed max --log-level 3 2>" + world.path("log");
    PallaxTerminal terminal(world, {"-c", command}, {.program = "/bin/sh"});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("s");
    ASSERT_TRUE(terminal.shows("Save snapshot"));
    terminal.type("\r\r");
    EXPECT_TRUE(terminal.shows(" File Error "));
    EXPECT_TRUE(terminal.shows("Unable to write file to disk"));
    EXPECT_TRUE(terminal.shows("[ Close ]"));
    EXPECT_TRUE(terminal.showsNoMore("Save snapshot"));
    terminal.type("\r");
    EXPECT_TRUE(terminal.showsNoMore("File Error"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_NE(contentOf(world.path("log"))
                  .find("<3>Unable to write snapshot to " + world.path("nowhere")),
              std::string::npos);
}

TEST_F(EndToEndScreen, ResizingIsSafeAtAnyMoment) {
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

TEST_F(EndToEndScreen, ItIsSuspendedAndComesBack) {
    PallaxTerminal terminal(world, {"--norc", "--noprofile", "-i"}, {.program = "/bin/bash"});
    ASSERT_TRUE(terminal.shows("$"));
    terminal.type(std::string(PALLAX_PROGRAM) + " " + changing() + " --speed 4\r");
    ASSERT_TRUE(terminal.shows("Process CO"));
    terminal.type("\x1a");
    ASSERT_TRUE(terminal.shows("Stopped"));
    EXPECT_FALSE(terminal.screen().isOnOtherScreen());
    terminal.type("fg\r");
    EXPECT_TRUE(terminal.showsNoMore("Stopped"));
    EXPECT_TRUE(terminal.shows("Process CO"));
    EXPECT_TRUE(terminal.screen().isOnOtherScreen());
    terminal.type("q");
    EXPECT_TRUE(terminal.shows("$"));
    terminal.type("exit\r");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, TheShellsTerminalStaysBlocking) {
    const std::string command = std::string(PALLAX_PROGRAM) + " " + brief() +
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

TEST_F(EndToEndScreen, EverySignalThatEndsItLeavesTheTerminalRestoredAndThePreferenceWritten) {
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

TEST_F(EndToEndScreen, ControlCEndsIt) {
    PallaxTerminal terminal(world, {changing(), "--speed", "4"}, {});
    ASSERT_TRUE(terminal.shows("Process CO"));
    terminal.type("\x03");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
    expectHomeScreenPreference();
}

TEST_F(EndToEndScreen, ACrashLeavesTheTerminalRestored) {
    for (const int number : {SIGSEGV, SIGABRT, SIGQUIT}) {
        PallaxTerminal terminal(world, {changing(), "--speed", "4"}, {});
        ASSERT_TRUE(terminal.shows("Process CO"));
        terminal.signal(number);
        EXPECT_EQ(terminal.wait(), -number);
        EXPECT_TRUE(terminal.isRestored()) << number;
    }
}

TEST_F(EndToEndScreen, AFatalRecordRestoresTheTerminalAndGivesOneSentence) {
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

TEST_F(EndToEndScreen, ColoursFollowOptionAndEnvironment) {
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

TEST_F(EndToEndScreen, ALocaleThatIsNotUtf8GetsAsciiMarks) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {.locale = "C"});
    ASSERT_TRUE(terminal.shows(">Serving PLMN"));
    EXPECT_TRUE(terminal.shows("End of the recording"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(std::all_of(terminal.bytes().begin(), terminal.bytes().end(),
                            [](char byte) { return byte >= 0; }));
}

TEST_F(EndToEndScreen, ADumbTerminalGetsThePrintedTree) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {.rows = 60, .type = "dumb"});
    EXPECT_TRUE(terminal.shows("== 2023-11-14 22:13:22 +0000\nServing PLMN\n"));
    EXPECT_TRUE(terminal.shows("\nProcess CO\n  MM Service State: REG_STATE_REGISTERING\n"));
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_EQ(terminal.bytes().find('\x1b'), std::string::npos);
}

TEST_F(EndToEndScreen, ATerminalTypeThatNobodyKnowsGivesOneSentence) {
    PallaxTerminal terminal(world, {brief()}, {.type = "no-such-terminal"});
    EXPECT_TRUE(terminal.shows("pallax: Nothing is known here of the terminal type "
                               "\"no-such-terminal\" (TERM); --\nprint does without.\n"));
    EXPECT_EQ(terminal.wait(), 1);
}

TEST_F(EndToEndScreen, KeysThatTheTerminalSendsDifferentlyFromItsTypeAreKnown) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {.type = "vt100"});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("jj");
    ASSERT_TRUE(terminal.shows("▌Process CO"));
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows("Pallax › Process CO"));
    terminal.type("\x1b[6~\x1b[1~\x1b[4~"); // a page down, Home, End: nothing goes back
    terminal.type("\x1b[200~\x1b[I");       // a paste begins, the focus comes: no keys
    terminal.settled();
    EXPECT_TRUE(terminal.shows("Pallax › Process CO"));
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.showsNoMore("Pallax ›"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, AnArrowThatComesInTwoPartsIsNoEscape) {
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

TEST_F(EndToEndScreen, InAPlainLocaleADescriptionIsStillUtf8) {
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

TEST_F(EndToEndScreen, ATerminalIsNoRecording) {
    PallaxTerminal terminal(world, {"-"}, {});
    EXPECT_TRUE(terminal.shows("pallax: Standard input is a terminal; pipe a recording into it."));
    EXPECT_EQ(terminal.wait(), 2);
}

TEST_F(EndToEndScreen, WithoutAServiceItSaysConnectingAndTheSpinnerTurns) {
    PallaxTerminal terminal(world, {}, {});
    EXPECT_TRUE(terminal.shows("⠋ Connecting"));
    EXPECT_TRUE(terminal.shows("⠹ Connecting"));
    EXPECT_EQ(terminal.screen().text().find("Connecting..."), std::string::npos);
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
}

TEST_F(EndToEndScreen, ATickClearsNothing) {
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
    EXPECT_LT(since.size(), 2000U) << "only what has changed is drawn";
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, KeysComeFromTheTerminalWhenStandardInputIsTheRecording) {
    const std::string command = std::string(PALLAX_PROGRAM) + " - --speed max < " + brief();
    PallaxTerminal terminal(world, {"-c", command}, {.program = "/bin/sh"});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("\r");
    EXPECT_TRUE(terminal.shows("Pallax › "));
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, LogLinesOnTheScreenAreRefused) {
    PallaxTerminal terminal(world, {brief(), "--log-level", "4"}, {});
    EXPECT_TRUE(terminal.shows("pallax: --log-level writes to standard error, which is the "
                               "screen here: send it\nto a file (2>FILE), or add --print.\n"));
    EXPECT_EQ(terminal.wait(), 2);
}

TEST_F(EndToEndScreen, TheValueUnderTheCursorIsCopied) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/process co\r\r/service\r");
    ASSERT_TRUE(terminal.shows("REG_STATE_REGISTERING"));
    terminal.type("y");
    EXPECT_TRUE(terminal.shows("Copied: REG_STATE_REGISTERING"));
    EXPECT_NE(terminal.bytes().find("\x1b]52;c;UkVHX1NUQVRFX1JFR0lTVEVSSU5H\a"), std::string::npos);
    terminal.signal(SIGTERM);
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreen, AClickOpensARowUnlessTheMouseIsLeftToTheTerminal) {
    {
        PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {});
        ASSERT_TRUE(terminal.shows("End of the recording"));
        terminal.type("\x1b[<0;5;3M\x1b[<0;5;3m"); // the first row
        EXPECT_TRUE(terminal.shows("Pallax › Serving PLMN"));
        terminal.signal(SIGTERM);
        EXPECT_EQ(terminal.wait(), 0);
    }
    PallaxTerminal terminal(world, {brief(), "--speed", "max", "--no-mouse"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    EXPECT_EQ(terminal.bytes().find("\x1b[?1000h"), std::string::npos);
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

} // namespace
} // namespace pallax
