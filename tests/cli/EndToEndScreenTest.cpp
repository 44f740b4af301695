#include "tests/cli/EndToEndScreen.h"

#include "plist/PropertyListCodec.h"

#include <csignal>
#include <filesystem>

namespace pallax {
namespace {

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
    EXPECT_TRUE(terminal.shows("of 11")); // the first pane keeps its filter
    terminal.type(kEscape);
    EXPECT_TRUE(terminal.shows("PDP Context Info"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
    EXPECT_EQ(terminal.screen().unknown(), "");
    expectHomeScreenPreference();
    expectNothingLeft();
}

TEST_F(EndToEndScreen, APaneWhoseSectionVanishesGoesBackToTheDeepestThatIsStillThere) {
    constexpr int kObjectStream = 147;
    const auto message = [](const char* text) {
        const std::string_view all = text;
        return ByteBuffer(all.begin(), all.end());
    };
    const std::string recording = record(
        "vanishing.pcap",
        {{std::chrono::seconds(0), message("{ SIM = { Files = { A = 1; B = 2; }; State = in; };"
                                           " Cell = { ARFCN = 1; BSIC = 2; }; }")},
         {std::chrono::seconds(41), message("{ SIM = { State = out; PIN = no; };"
                                            " Cell = { ARFCN = 1; BSIC = 2; }; }")}},
        kObjectStream);
    PallaxTerminal terminal(world, {recording, "--speed", "10"}, {});
    ASSERT_TRUE(terminal.shows("SIM"));
    terminal.type("/sim\r\r");
    ASSERT_TRUE(terminal.shows("Pallax › SIM"));
    terminal.type("/files\r\r");
    ASSERT_TRUE(terminal.shows("Pallax › SIM › Files"));
    EXPECT_TRUE(terminal.showsNoMore("› Files"));
    EXPECT_TRUE(terminal.shows("Pallax › SIM"));
    terminal.type(kEscape); // clears the filter of the pane that is shown again
    EXPECT_TRUE(terminal.shows("PIN"));
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
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
    ASSERT_EQ(data->size(), 2U); // one history entry and the DLF log
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
    const std::string command = doubles::programPath() + " " + brief() +
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

TEST_F(EndToEndScreen, WithoutAServiceItSaysConnectingAndTheSpinnerTurns) {
    PallaxTerminal terminal(world, {}, {});
    EXPECT_TRUE(terminal.shows("⠋ Connecting"));
    EXPECT_TRUE(terminal.shows("⠹ Connecting"));
    EXPECT_EQ(terminal.screen().text().find("Connecting..."), std::string::npos);
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
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
