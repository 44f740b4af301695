#include "tests/window/EndToEndWindow.h"

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

using doubles::CommandRun;
using std::chrono::milliseconds;

TEST_F(EndToEndWindow, ARecordingIsOpenedAndWalkedThroughByKeys) {
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Zorell_LTE · lte-drive.pcap' open 'Serving Cell Info' "
                       "has 'Physical Cell ID: *' lacks Save"));
}

TEST_F(EndToEndWindow, AValueIsExplainedWithItsCurve) {
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:20' open 'Serving Cell Measurements' "
                       "open 'Measured RSRP: *' has 'Reference signal received power*' "
                       "has 'Curve: -100.25*' press Back lacks 'Curve: -100.25*' "
                       "has 'Measured RSRP: *'"));
}

TEST_F(EndToEndWindow, ADemoRunsUntilItIsEnded) {
    expectDriven(drive("demo gsm --seed 7", "has 'Zorell_GSM · simulated gsm' "
                                            "has 'UMTS RR Info'"));
}

TEST_F(EndToEndWindow, TimeIsHeldSteppedAndReleased) {
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:20' focus 'SIM Info' key space "
                       "has Play press 'Event before' has '22:15:19, held*' "
                       "press 'Event before' has '22:15:18, held*' "
                       "press 'To the present' lacks '22:15:18, held*' has Hold"));
}

TEST_F(EndToEndWindow, SpeaksGermanButKeepsTheModemsTexts) {
    if (!std::filesystem::exists(PALLAX_BINARY_DIR "/locale")) {
        GTEST_SKIP() << "gettext is not installed";
    }
    world.environment.insert(world.environment.end(), {"LANG=C.UTF-8", "LANGUAGE=de"});
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Menü' has 'Netzbetreiber' has 'Serving Cell Info' "
                       "has 'Updated 2023-11-14 at 22:15:20'"));
}

TEST_F(EndToEndWindow, ClosingTheWindowEndsTheProgram) {
    expectDriven(drive("demo", "has 'SIM Info' press Close lacks 'SIM Info'"));
}

TEST_F(EndToEndWindow, ASnapshotIsSaved) {
    const std::string folder = offerSaving(world.path("marker"));
    expectDriven(
        drive(sample("lte-drive.pcap") + " --speed max",
              "has 'SIM Info' press Save has 'DLF binary*' type 'Description=tunnel entrance' "
              "press Save lacks 'DLF binary*' has 'Saved *'"));
    std::string content;
    for (const auto& entry : std::filesystem::directory_iterator(folder)) {
        std::ifstream file(entry.path());
        content.assign(std::istreambuf_iterator<char>(file), {});
    }
    EXPECT_NE(content.find("<key>Description</key>\n\t<string>tunnel entrance</string>"),
              std::string::npos);
}

TEST_F(EndToEndWindow, AFailureToSaveIsAnAlertOverThePanes) {
    offerSaving(world.path("missing/folder"));
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'SIM Info' press Save has 'DLF binary*' press Save "
                       "has 'Unable to write file to disk' lacks 'DLF binary*'"));
}

TEST_F(EndToEndWindow, ARecordThatThrowsEndsTheProgramWithAPageAndASentence) {
    const std::string recording = record("fatal.pcap", {{milliseconds(0), registration(0)},
                                                        {milliseconds(10), unreadableSimFiles()}});
    constexpr const char* kSentence =
        "packet 2 (log code 0xFF0000): the embedded property list cannot be parsed";
    const CommandRun run =
        drive(recording + " --speed max",
              "has 'Pallax has stopped' has '" + std::string(kSentence) + "*' press Close");
    expectDriven(run, 70);
    EXPECT_NE(run.out.find("pallax: " + std::string(kSentence)), std::string::npos) << run.out;
}

TEST_F(EndToEndWindow, AMissingRecordingIsASentence) {
    const Run missing = run({world.path("none.pcap")});
    EXPECT_EQ(missing.status, 1);
    EXPECT_EQ(missing.err, "pallax: " + world.path("none.pcap") +
                               " cannot be opened: No such file or directory.\n");
}

TEST_F(EndToEndWindow, ADamagedRecordingIsASentence) {
    std::ofstream(world.path("damaged.pcap")) << "no capture";
    const Run damaged = run({world.path("damaged.pcap")});
    EXPECT_EQ(damaged.status, 1);
    EXPECT_EQ(damaged.err, "pallax: " + world.path("damaged.pcap") +
                               " is not a recording: it is neither pcap nor pcapng.\n");
}

TEST_F(EndToEndWindow, WithoutADisplayThereIsASentence) {
    world.environment = {"GDK_BACKEND=x11"};
    const Run none = run({"demo"});
    EXPECT_EQ(none.status, 1);
    EXPECT_EQ(none.err, "pallax: There is no display for a window; pallax shows the same in a "
                        "terminal.\n");
}

} // namespace
} // namespace pallax
