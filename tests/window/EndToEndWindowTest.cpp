#include "tests/window/EndToEndWindow.h"

#include "tests/doubles/TextPropertyList.h"

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

TEST_F(EndToEndWindow, EventsHitsAndAnswersAreTablesThatGoToTheirInstant) {
    expectDriven(
        drive(sample("lte-drive.pcap") + " --speed max",
              "has 'Updated 2023-11-14 at 22:15:20' focus 'SIM Info' key e "
              "open 'Time 22:15:14, Kind cell-change, What serving cell 82 → 286 after 17 s' "
              "has '22:15:15, held*' focus 'SIM Info' key ';' "
              "type 'Question in SQL=select packet, kind from event order by packet' key Return "
              "press 'packet' press 'packet, sorted, least first' "
              "has 'packet, sorted, greatest first' open 'packet 93, kind context-up' "
              "has '22:13:29, held*' focus 'SIM Info' key f "
              "type 'Find a text in names and values=context down' "
              "has 'Nothing in this instant contains this text.' "
              "press 'Whole Recording' has 'Time 22:13:53, Name context-down*' "
              "key Escape lacks 'Whole Recording' press 'To the present' "
              "lacks '*, held*' open 'SIM Info'"));
}

TEST_F(EndToEndWindow, TheNextAndThePreviousHitOfATextAreFoundByKeys) {
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:20' focus 'SIM Info' key f "
                       "type 'Find a text in names and values=rsrp' has 'Name Average RSRP, *' "
                       "key Return has 'Average RSRP: *' key n has 'rsrp: 2 of *' "
                       "key N has 'rsrp: 1 of *' key f press 'Whole Recording' "
                       "type 'Find a text in names and values=context down' "
                       "has 'Time 22:13:53, *' key Return has '22:13:53, held*' "
                       "lacks 'Whole Recording' key n lacks '22:13:53, held*' "
                       "key N has '22:13:53, held*' key N has 'There is no earlier hit.'"));
}

TEST_F(EndToEndWindow, AListIsATableWithColumns) {
    expectDriven(
        drive(sample("lte-drive.pcap") + " --speed max",
              "has 'Updated 2023-11-14 at 22:15:20' open 'Neighbor Cells List, 2' "
              "press 'Show as Table' has 'Physical Cell ID 184, Measured RSSI -64.00 dBm*' "
              "press 'Measured RSRP dBm' has 'Measured RSRP dBm, sorted, *' "
              "open 'Physical Cell ID 285, *' has 'Physical Cell ID: 285' key Escape "
              "press 'Show as Rows' lacks 'Physical Cell ID 184, *'"));
}

TEST_F(EndToEndWindow, LongListsAndLongValuesAreScrolledByKeys) {
    constexpr int kIfxLinkType = 147;
    Dictionary section{{"Longest", PropertyList(std::string(200, 'x'))}};
    for (int number = 100; number < 160; ++number) {
        section.set(Text("Value " + std::to_string(number)), PropertyList(std::to_string(number)));
    }
    const std::string text = doubles::textForm(Dictionary{{"Cell", section}});
    const std::string recording = record(
        "long.pcap", {{milliseconds(0), ByteBuffer(text.begin(), text.end())}}, kIfxLinkType);
    expectDriven(drive(recording + " --speed max",
                       "open 'Cell' focus 'Value 100: *' key End key Return has 'Curve: 159*' "
                       "key Escape lacks 'Curve: 159*' key Home "
                       "focus 'Longest: *' key Right pushed 'Longest: *' "));
}

TEST_F(EndToEndWindow, ACurveIsReadByKeysAndForAnotherTime) {
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:20' open 'Serving Cell Measurements' "
                       "open 'Measured RSRP: *' has 'Curve: -100.25*22:10:19*last -94.5 dBm' "
                       "press 'the last 30 seconds' has 'Curve: *22:14:49 *' "
                       "key End has '22:15:19  -94.5 dBm*' key Left has '22:15:1*' "
                       "key + key - has 'Curve: *22:14:19 *'"));
}

TEST_F(EndToEndWindow, TheGraphHasTheCurvesOfSeveralValues) {
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:20' open 'Serving Cell Measurements' "
                       "open 'Measured RSRP: *' press 'Add to the Graph' "
                       "has 'In the graph (1 of 6)*' press Back "
                       "open 'Measured RSRQ: *' has 'Curve: -14.5*' key v "
                       "has 'In the graph (2 of 6)*' key V "
                       "has 'Curves: a  -94.50 dBm  Measured RSRP, Serving*' "
                       "has 'Curves: b  -11.00 dB  Measured RSRQ, Serving*' "
                       "key V lacks 'Curves: a*' has 'Remove from the Graph' "
                       "press 'Open the Graph' has 'Curves: a*' key Escape lacks 'Curves: a*' "
                       "has 'Remove from the Graph' key Escape lacks 'Remove from the Graph' "
                       "has 'Measured RSRQ: *'"));
}

TEST_F(EndToEndWindow, ARowOfAValueIsAddedToTheGraphByAKey) {
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:20' focus 'SIM Info' key v "
                       "has 'Nothing to show here: choose a value.' "
                       "open 'Serving Cell Measurements' focus 'Measured RSRQ: *' key v "
                       "has 'In the graph (1 of 6): V opens it.' key V "
                       "has 'Curves: a  -11.00 dB  Measured RSRQ, Serving*' key Escape "
                       "focus 'Measured RSRQ: *' key v has 'No longer in the graph.'"));
}

TEST_F(EndToEndWindow, WhatDiffersFromTheMarkIsAPage) {
    expectDriven(
        drive(sample("lte-drive.pcap") + " --speed max",
              "has 'Updated 2023-11-14 at 22:15:20' focus 'SIM Info' key d "
              "has 'Mark an instant first, with the key m.' "
              "key [ has '22:15:19, held*' key m has 'Marked 22:15:19*' "
              "key [ has '22:15:18, held*' key d has 'Changes from 22:15:19 to 22:15:18' "
              "key [ has 'Changes from 22:15:19 to 22:15:*' key Escape lacks 'Changes from *'"));
}

TEST_F(EndToEndWindow, AfterAPlaceIsReachedTheKeysAreTheWindowsAgain) {
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:20' focus 'SIM Info' key : "
                       "type 'Go to a time, or to where a condition becomes true=rsrp < -95' "
                       "key Return has 'no such column: rsrp.*' "
                       "type 'Go to a time, or to where a condition becomes true=22:14:00' "
                       "key Return has '22:14:00, held*' key m has 'Marked 22:14:00*'"));
}

TEST_F(EndToEndWindow, MessagesMayComeInQuickSuccession) {
    std::string held;
    for (int time = 0; time < 100; ++time) {
        held += "key d ";
    }
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:20' focus 'SIM Info' " + held +
                           "has 'Mark an instant first, with the key m.' open 'SIM Info'"));
}

TEST_F(EndToEndWindow, ALongSearchTellsHowFarItIsAndIsCancelled) {
    std::vector<Packet> packets;
    for (int number = 0; number < 100000; ++number) {
        packets.emplace_back(milliseconds(number), registration(number % 2 == 0 ? 0 : 1));
    }
    const std::string recording = record("long.pcap", packets);
    // For each packet, a long text is made.
    const std::string never = "length(replace(hex(zeroblob(4000)), 0, 12)) < 0";
    expectDriven(drive(recording + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:00' focus 'SIM Info' key ^ "
                       "has '22:13:20, held*' key : "
                       "type 'Go to a time, or to where a condition becomes true=" +
                           never +
                           "' key Return has 'Searching: *' press Cancel "
                           "has 'The search was stopped.' lacks 'Searching: *' "
                           "key Return has 'Searching: *' key Escape lacks 'Searching: *' "
                           "press 'To the present' lacks '22:13:20, held*'"));
}

TEST_F(EndToEndWindow, TheSettingsSayHowListsAreShownFirst) {
    std::filesystem::create_directories(world.path("config/pallax"));
    std::ofstream(world.path("config/pallax/pallax.conf")) << "lists = table\n";
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'Updated 2023-11-14 at 22:15:20' open 'Neighbor Cells List, 2' "
                       "has 'Physical Cell ID 184, *' has 'Show as Rows'"));
}

TEST_F(EndToEndWindow, ALongQueryIsToldAndStopped) {
    expectDriven(
        drive(sample("lte-drive.pcap") + " --speed max",
              "has 'Updated 2023-11-14 at 22:15:20' focus 'SIM Info' key ';' "
              "type 'Question in SQL=with recursive n(i) as (select 1 union all select i + 1 from "
              "n) select count(*) from n' key Return has 'The query is running.' press Cancel "
              "has 'The query was stopped.' key Escape lacks 'The query was stopped.'"));
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
    expectDriven(runOnBus("timeout -s KILL 60 " PALLAX_PROGRAM " demo & p=$!\n" +
                          driving("has 'SIM Info' press Close lacks 'SIM Info'") +
                          "wait $p; exit $?\n"));
}

TEST_F(EndToEndWindow, ASnapshotIsSaved) {
    const std::string folder = offerSaving(world.path("marker"));
    expectDriven(drive(
        sample("lte-drive.pcap") + " --speed max",
        "has 'SIM Info' menu 'Save Snapshot…' has 'DLF binary*' type 'Description=tunnel entrance' "
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
