#include "inspecting/DiffCommand.h"

#include "console/Output.h"
#include "inspecting/DiffText.h"
#include "overview/DifferenceText.h"
#include "tests/inspecting/InspectingFixture.h"

#include <filesystem>

namespace pallax {
namespace {

using Sentences = std::vector<std::string>;

class DiffCommandTest : public InspectingFixture {
protected:
    ExitStatus run(const std::string& before, const std::string& after) {
        options.before = before;
        options.after = after;
        written.clear();
        reports.clear();
        Output output([this](std::string_view block) { written += block; });
        const DiffCommand::Environment environment{
            decoder, zone, [this](const std::string& sentence) { reports.push_back(sentence); }};
        return DiffCommand(options, environment).run(output);
    }
    /// A copy of a sample under another name.
    std::string copy(const std::string& name, const std::string& as) {
        std::filesystem::copy_file(sample(name), folder.file(as));
        return folder.file(as);
    }

    DiffOptions options;
    std::string lte = sample("lte-drive.pcap");
};

TEST_F(DiffCommandTest, TwoMomentsOfARecordingAreComparedByIdentity) {
    options.select = {"*.measured_rsrp", "*.physical_cell_id", "*.filtered_rsrp",
                      "lte.pdp_context_info"};
    EXPECT_EQ(run(lte + "@+40s", lte + "@+80s"), kExitFailure);
    EXPECT_EQ(written, "before  " + lte + ", 2023-11-14 22:14:00\n" + "after   " + lte +
                           ", 2023-11-14 22:14:40\n"
                           "\n"
                           "Serving Cell Measurements\n"
                           "  Measured RSRP  -77.50 dBm → -94.50 dBm (-17.00 dB)\n"
                           "\n"
                           "Neighbor Cells List\n"
                           "  Physical Cell ID 183  gone\n"
                           "  Physical Cell ID 285  new\n"
                           "    Measured RSRP  -97.00 dBm\n"
                           "  Physical Cell ID 82  new\n"
                           "    Measured RSRP  -96.50 dBm\n"
                           "  Physical Cell ID 386  new\n"
                           "    Measured RSRP  -100.00 dBm\n"
                           "\n"
                           "Measured Neighbor Cells\n"
                           "  Physical Cell ID 386  new\n"
                           "    Filtered RSRP  -96.75 dBm\n"
                           "\n"
                           "Detected Cells\n"
                           "  Physical Cell ID 285  new\n"
                           "  Physical Cell ID 284  new\n");
    EXPECT_EQ(reports, Sentences());
}

TEST_F(DiffCommandTest, TheNameOfAFileCannotCommandATerminal) {
    options.select = {"lte.serving_cell_measurements.measured_rsrp"};
    const std::string hostile = copy("lte-drive.pcap", "a\n\x1B[2Jb.pcap");
    EXPECT_EQ(run(hostile + "@+40s", hostile + "@+80s"), kExitFailure);
    EXPECT_EQ(written, "before  " + folder.file("a\\x0A\\x1B[2Jb.pcap") +
                           ", 2023-11-14 22:14:00\n" + "after   " +
                           folder.file("a\\x0A\\x1B[2Jb.pcap") +
                           ", 2023-11-14 22:14:40\n"
                           "\n"
                           "Serving Cell Measurements\n"
                           "  Measured RSRP  -77.50 dBm → -94.50 dBm (-17.00 dB)\n");
}

TEST_F(DiffCommandTest, NothingIsWrittenWhereNothingDiffers) {
    EXPECT_EQ(run(lte, lte), kExitSuccess);
    EXPECT_EQ(run(lte + "@end", copy("lte-drive.pcap", "again.pcap")), kExitSuccess);
    EXPECT_EQ(written, "");
    EXPECT_EQ(reports, Sentences());
}

TEST_F(DiffCommandTest, TheEndIsThatOfTheLastPacketWhereTheClockWasSetBack) {
    const std::string path = driveSetBack();
    EXPECT_EQ(run(path + "@end", path), kExitSuccess) << written;
    EXPECT_EQ(run(path + "@-60s", path + "@end"), kExitFailure);
}

TEST_F(DiffCommandTest, OfTwoFilesTheAnswerIsThatOfOne) {
    const std::string again = copy("lte-drive.pcap", "again.pcap");
    options.json = true;
    EXPECT_EQ(run(lte + "@+40s", lte + "@+80s"), kExitFailure);
    const std::string within = written;
    EXPECT_EQ(run(lte + "@+40s", again + "@+80s"), kExitFailure);
    EXPECT_EQ(written, within);
}

TEST_F(DiffCommandTest, CountersAndHiddenFieldsAreComparedOnRequest) {
    const auto counters = [](const char* number) {
        return Dictionary{{"Connected mode LTE Intra-frequency Measurement",
                           Dictionary{{"Subframe Number", number}}}};
    };
    const std::string before = folder.file("before.pallax");
    std::filesystem::rename(snapshot({{"2023-11-14 22:13:20 +0000", counters("1")}}), before);
    const std::string after = snapshot({{"2023-11-14 22:13:22 +0000", counters("2")}});
    EXPECT_EQ(run(before, after), kExitSuccess);
    options.all = true;
    EXPECT_EQ(run(before, after), kExitFailure);
    EXPECT_EQ(written, "before  " + before + ", 2023-11-14 22:13:20\n" + "after   " + after +
                           ", 2023-11-14 22:13:22\n\n"
                           "Connected mode LTE Intra-frequency Measurement\n"
                           "  Subframe Number  1 → 2\n");
    options.all = false;
    options.select = {"*.subframe_number"};
    EXPECT_EQ(run(before, after), kExitFailure);
}

TEST_F(DiffCommandTest, DisplaysOfOneSnapshotMayShareSections) {
    const auto serving = [](const char* pci) {
        return Dictionary{{"Serving Cell Info", Dictionary{{"Physical Cell ID", pci}}},
                          {"Neighbor Cells List", Array()}};
    };
    const std::string path = snapshot({{"2023-11-14 22:13:20 +0000", serving("182")},
                                       {"2023-11-14 22:13:22 +0000", serving("183")}});
    const Sentences shared{
        "Displays that share a section all show it as it was when the snapshot was saved."};
    EXPECT_EQ(run(path + "@22:13:20", path), kExitCouldNotTell);
    EXPECT_EQ(reports, shared);
    EXPECT_NE(written.find("Physical Cell ID  182 → 183"), std::string::npos) << written;
    EXPECT_EQ(run(path + "@22:13:20", path + "@+1s"), kExitSuccess) << "one display";
    EXPECT_EQ(reports, shared);
    EXPECT_EQ(run(path + "@22:13:22", path), kExitSuccess);
    EXPECT_EQ(reports, Sentences());
    options.select = {"lte.serving_cell_info.physical_cell_id"};
    EXPECT_EQ(run(path + "@22:13:20", lte), kExitFailure);
    EXPECT_EQ(reports, shared);
}

TEST_F(DiffCommandTest, ASnapshotIsComparedWithARecording) {
    const std::string path =
        snapshot({{"2023-11-14 22:13:20 +0000",
                   {{"Serving Cell Measurements",
                     Dictionary{{"Measured RSRP", "-94.75 dBm"}, {"Physical Cell ID", "1"}}}}}});
    options.select = {"lte.serving_cell_measurements.measured_rsrp"};
    EXPECT_EQ(run(path, lte), kExitFailure);
    EXPECT_EQ(written.substr(written.find("\n\n")), "\n\nServing Cell Measurements\n"
                                                    "  Measured RSRP  -94.75 dBm → -94.50 dBm "
                                                    "(+0.25 dB)\n");
}

TEST_F(DiffCommandTest, ASnapshotIsReadFromStandardInput) {
    const std::string path =
        snapshot({{"2023-11-14 22:13:20 +0000",
                   {{"Serving Cell Measurements",
                     Dictionary{{"Measured RSRP", "-94.75 dBm"}, {"Physical Cell ID", "1"}}}}}});
    withInput(path, [&] { EXPECT_EQ(run("-", path), kExitSuccess); });
    EXPECT_EQ(reports, Sentences());
    withInput(path, [&] { EXPECT_EQ(run("-", lte), kExitFailure); });
    EXPECT_TRUE(written.starts_with("before  standard input, 2023-11-14 22:13:20\n")) << written;
}

TEST_F(DiffCommandTest, AFileWhoseNameContainsTheMarkOfATimeIsFoundFirst) {
    const std::string path = copy("lte-drive.pcap", "drive@+40s");
    EXPECT_EQ(run(path, lte), kExitSuccess);
    EXPECT_EQ(run(path + "@+40s", lte), kExitFailure) << "the last mark is that of the time";
}

TEST_F(DiffCommandTest, WhatCannotBeComparedCannotBeTold) {
    const std::string gsm = sample("gsm-attach.pcap");
    EXPECT_EQ(run(lte, gsm), kExitCouldNotTell);
    EXPECT_EQ(reports,
              Sentences{lte + " is of lte and " + gsm + " of gsm: they have no fields in common."});
    EXPECT_EQ(run(lte, "/no/such.pcap@+1s"), kExitCouldNotTell);
    EXPECT_EQ(reports, Sentences{"/no/such.pcap cannot be opened: No such file or directory."});
    EXPECT_EQ(run("/no/such.pcap", lte), kExitCouldNotTell);
    EXPECT_EQ(run(lte + "@2020-01-01", lte), kExitCouldNotTell);
    const std::string outside = " is no time of the recording, which lasts from 2023-11-14 "
                                "22:13:20 to 2023-11-14 22:15:19.";
    EXPECT_EQ(reports, Sentences{lte + ": \"2020-01-01\"" + outside});
    for (const std::string time : {"03:00", "22:19", "+301s", "2023-11-14T22:19"}) {
        EXPECT_EQ(run(lte, lte + "@" + time), kExitCouldNotTell);
        EXPECT_EQ(reports, Sentences{lte + ": \"" + time + "\"" + outside});
    }
    EXPECT_EQ(written, "");
}

TEST_F(DiffCommandTest, OfADamagedRecordingTheDifferencesAreNotAll) {
    const std::string path = copy("lte-drive.pcap", "cut.pcap");
    std::filesystem::resize_file(path, std::filesystem::file_size(path) - 10);
    EXPECT_EQ(run(path + "@start", path), kExitCouldNotTell);
    EXPECT_EQ(reports, Sentences{path + " ends in the middle of a packet."});
    EXPECT_NE(written.find("Serving Cell Info"), std::string::npos);
    EXPECT_EQ(run(lte, path), kExitCouldNotTell);
    EXPECT_EQ(reports, Sentences{path + " ends in the middle of a packet."});
}

TEST_F(DiffCommandTest, WrongNamesAndTimesAreWrongUsage) {
    EXPECT_EQ(run(lte + "@noon", lte), kExitWrongUsage);
    EXPECT_EQ(run(lte, lte + "@"), kExitWrongUsage);
    options.select = {"lte.*", "lte.no_such"};
    EXPECT_EQ(run(lte, lte), kExitWrongUsage);
    EXPECT_EQ(reports, Sentences{"no field is named \"lte.no_such\" (see pallax diff --help)"});
}

FieldInfo fieldAt(const char* path, bool identifies = false) {
    FieldInfo field;
    field.name = "a.field";
    field.path = path;
    field.identifies = identifies;
    return field;
}

FieldValue valueOf(const char* text) {
    FieldValue value;
    value.shown = text;
    return value;
}

TEST(DiffText, HasSectionsAndEntriesAsTheDisplay) {
    using Kind = Difference::Kind;
    const FieldInfo state = fieldAt("/RR");
    const FieldInfo channel = fieldAt("/1x/Receiver 0/Channel");
    const FieldInfo pilot = fieldAt("/EV-DO/Active Set/*");
    const FieldInfo pci = fieldAt("/Cells/*/PCI", true);
    const FieldInfo level = fieldAt("/Cells/*/Level");
    const FieldInfo quality = fieldAt("/Cells/*/Low Quality");
    std::string text;
    appendDifferencesText(text,
                          {{Kind::Changed, &state, "", valueOf("Idle"), valueOf("De\ndicated"), {}},
                           {Kind::Changed, &channel, "", {}, valueOf("384"), {}},
                           {Kind::Changed, &level, "PCI 1", valueOf("-9 dB"), valueOf("-8 dB"),
                            Difference::Amount{1.0, "+1 dB", "dB"}},
                           {Kind::Changed, &quality, "PCI 1", valueOf("-9"), {}, {}},
                           {Kind::Gone, &pci, "PCI 2", valueOf("2"), {}, {}},
                           {Kind::Gone, &level, "PCI 2", valueOf("-7 dB"), {}, {}},
                           {Kind::Changed, &pilot, "PN 5", valueOf("-2 dB"), valueOf("-3 dB"), {}},
                           {Kind::New, &pci, "PCI 3", {}, valueOf("3"), {}},
                           {Kind::New, &level, "PCI 3", {}, valueOf("-6 dB"), {}},
                           {Kind::New, &pilot, "PN 6", {}, valueOf("-1 dB"), {}},
                           {Kind::Gone, &pilot, "PN 7", valueOf("-4 dB"), {}, {}}});
    EXPECT_EQ(text, "\nRR  Idle → De\\x0Adicated\n"
                    "\n1x/Receiver 0\n"
                    "  Channel  none → 384\n"
                    "\nCells\n"
                    "  PCI 1\n"
                    "    Level        -9 dB → -8 dB (+1 dB)\n"
                    "    Low Quality  -9 → none\n"
                    "  PCI 2  gone\n"
                    "  PCI 3  new\n"
                    "    Level  -6 dB\n"
                    "\nEV-DO/Active Set\n"
                    "  PN 5  -2 dB → -3 dB\n"
                    "  PN 6  new  -1 dB\n"
                    "  PN 7  gone  -4 dB\n");
}

TEST(DiffText, JsonIsALineForEachValue) {
    using Kind = Difference::Kind;
    const FieldInfo level = fieldAt("/Cells/*/Level");
    FieldValue before = valueOf("-9 dB");
    before.number = -9;
    FieldValue after = valueOf("-8 dB");
    after.number = -8;
    std::string json;
    appendDifferencesJson(json, {{Kind::Changed, &level, "PCI 1", before, after,
                                  Difference::Amount{1.0, "+1 dB", "dB"}},
                                 {Kind::Gone, &level, "", before, {}, {}},
                                 {Kind::New, &level, "PCI 2", {}, after, {}}});
    EXPECT_EQ(json,
              R"({"field":"a.field","entry":"PCI 1","change":"changed","before":"-9 dB",)"
              R"("after":"-8 dB","before_number":-9,"after_number":-8,"difference":1,"unit":"dB"})"
              "\n"
              R"({"field":"a.field","entry":null,"change":"gone","before":"-9 dB","after":null,)"
              R"("before_number":-9,"after_number":null,"difference":null,"unit":null})"
              "\n"
              R"({"field":"a.field","entry":"PCI 2","change":"new","before":null,)"
              R"("after":"-8 dB","before_number":null,"after_number":-8,"difference":null,)"
              R"("unit":null})"
              "\n");
}

} // namespace
} // namespace pallax
