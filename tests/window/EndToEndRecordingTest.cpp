#include "tests/window/EndToEndWindow.h"
#include "tests/window/PacketsIn.h"

#include <filesystem>

namespace pallax {
namespace {

using doubles::CommandRun;
using doubles::contentOf;
using doubles::packetsIn;

/// Recordings that the window makes.
class EndToEndRecording : public EndToEndWindow {
protected:
    /// The steps that begin a recording in this file.
    static std::string recordInto(const std::string& path) {
        // The toolkit calls a button with a mnemonic twice by its name.
        return "menu 'Record…' type 'Name:=" + path + "' press 'Record Record' ";
    }
    std::string target() const { return world.path("made.pcapng"); }

    /// The same as `drive`, with a session manager that writes into the file "awake".
    CommandRun driveWithSessionManager(const std::string& arguments,
                                       const std::string& steps) const {
        return runOnBus("/usr/bin/python3 " PALLAX_SOURCE_DIR "/tests/window/session_manager.py " +
                        world.path("awake") + " >" + world.path("ready") + " & m=$!\n" +
                        "until grep -q ready " + world.path("ready") + "; do sleep 0.05; done\n" +
                        PALLAX_PROGRAM " " + arguments + " & p=$!\n" + driving(steps) +
                        "kill -TERM $p 2>/dev/null; wait $p; s=$?; kill $m; exit $s\n");
    }
};

TEST_F(EndToEndRecording, ASimulatedModemIsRecordedUntilItIsStopped) {
    expectDriven(drive("demo lte --seed 7", "has 'SIM Info' " + recordInto(target()) +
                                                "has made.pcapng lacks '0 packets*' press Stop "
                                                "has 'Recorded made.pcapng' lacks Stop"));
    EXPECT_GT(packetsIn(target()), 0U);
}

TEST_F(EndToEndRecording, TheFileIsWholeWhenTheProgramIsEnded) {
    expectDriven(drive("demo lte --seed 7", "has 'SIM Info' " + recordInto(target()) +
                                                "has made.pcapng lacks '0 packets*'"));
    EXPECT_GT(packetsIn(target()), 0U);
}

TEST_F(EndToEndRecording, ClosingTheWindowAsksFirst) {
    // The program ends by itself; it is ended only if it does not.
    expectDriven(
        runOnBus(PALLAX_PROGRAM " demo lte & p=$!\n" +
                 driving("has 'SIM Info' " + recordInto(target()) +
                         "has made.pcapng lacks '0 packets*' press Close "
                         "has 'A recording is being made.' press 'Keep Recording Keep Recording' "
                         "lacks 'A recording is being made.' has made.pcapng "
                         "press Close press 'Stop and Close Stop and Close' lacks 'SIM Info'") +
                 "for i in $(seq 100); do kill -0 $p 2>/dev/null || break; sleep 0.1; done\n"
                 "kill -TERM $p 2>/dev/null; wait $p; exit $?\n"));
    EXPECT_GT(packetsIn(target()), 0U);
}

TEST_F(EndToEndRecording, AFullDiskIsAnAlert) {
    const CommandRun run = runOnBus(
        "(ulimit -f 8; exec " PALLAX_PROGRAM " demo lte) & p=$!\n" +
        driving("has 'SIM Info' " + recordInto(target()) + "has 'Recording Failed' lacks Stop") +
        "kill -TERM $p; wait $p; exit $?\n");
    expectDriven(run);
    EXPECT_GT(packetsIn(target()), 0U);
}

TEST_F(EndToEndRecording, ARecordingThatIsNotWholeAtTheEndIsAFailure) {
    const CommandRun run =
        runOnBus(PALLAX_PROGRAM " demo lte & p=$!\n" +
                 driving("has 'SIM Info' " + recordInto(target()) + "has made.pcapng") + "rm " +
                 target() + "; kill -TERM $p; wait $p; exit $?\n");
    expectDriven(run, 1);
    EXPECT_NE(run.out.find("pallax: The recording " + target()), std::string::npos) << run.out;
}

TEST_F(EndToEndRecording, OnlyARecordingKeepsTheMachineAwake) {
    expectDriven(driveWithSessionManager("demo lte", "has 'SIM Info' " + recordInto(target()) +
                                                         "has made.pcapng press Stop lacks Stop"));
    EXPECT_EQ(contentOf(world.path("awake")),
              "inhibit example.pallax.Pallax suspend+idle: A recording is being made.\n"
              "uninhibit 7\n");
}

TEST_F(EndToEndRecording, ARecordingThatIsShownIsNotOfferedForRecording) {
    const CommandRun run = drive(sample("lte-drive.pcap"),
                                 "has 'SIM Info' press Menu has 'Open Recording…' lacks 'Record…' "
                                 "lacks 'Save Snapshot…'");
    expectDriven(run);
}

} // namespace
} // namespace pallax
