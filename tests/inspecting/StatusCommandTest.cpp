#include "inspecting/StatusCommand.h"

#include "console/Output.h"
#include "tests/inspecting/InspectingFixture.h"

#include <filesystem>

namespace pallax {
namespace {

class StatusCommandTest : public InspectingFixture {
protected:
    ExitStatus run(const std::string& path) {
        options.recording = path;
        written.clear();
        reports.clear();
        Output output([this](std::string_view block) { written += block; });
        const QualityProfile profile = *builtInProfile(options.profile);
        const StatusCommand::Environment environment{
            decoder, names, profile, zone,
            [this](const std::string& sentence) { reports.push_back(sentence); }};
        return StatusCommand(options, environment).run(output);
    }
    /// The lines below the head, which has the path.
    std::string lines(const std::string& path) {
        EXPECT_EQ(run(path), kExitSuccess);
        EXPECT_EQ(reports, std::vector<std::string>());
        return written.substr(written.find('\n') + 1);
    }

    StatusOptions options;
    NetworkNames names;
};

TEST_F(StatusCommandTest, OfEachTechnologyIsAtTheEndOfTheRecording) {
    EXPECT_EQ(lines(sample("lte-drive.pcap")),
              "operator    Sample Net 262-42 · home network · name from the SIM\n"
              "cell        eNodeB 104475 sector 1 · PCI 184 · TAC 6699 · EARFCN 1850 · band 3\n"
              "            1870.0 MHz\n"
              "levels      profile android · RSRP -92.75 dBm excellent · RSRQ -12.62 dB good\n"
              "neighbours  PCI 285 -90.00 dBm · PCI 286 -97.00 dBm · PCI 387 -98.50 dBm\n"
              "contexts    ims Active · internet Active\n");
    EXPECT_EQ(lines(sample("umts-drive.pcap")),
              "operator    Sample Net 262-42 · name from the SIM\n"
              "GSM cell    cell 12081 · BSIC 33 · 63 s ago · ARFCN 42 · band P-GSM 900\n"
              "            943.4 MHz · 30 s ago\n"
              "UMTS cell   RNC 164 cell 388 · PSC 388 · UARFCN 10713 · band I · 2142.6 MHz\n"
              "levels      profile android · UMTS RSCP -84 dB excellent · UMTS Ec/Io -9 dB fair\n"
              "state       MM_IDLE · GMM_REGISTERED · RR_INACTIVE · RRC Disconnected\n"
              "neighbours  ARFCN 17 BSIC 42 -91 dBm · ARFCN 86 BSIC 17 -95 dBm\n"
              "            ARFCN 771 BSIC 5 -97 dBm\n"
              "contexts    internet Active · mms Inactive\n");
    EXPECT_EQ(lines(sample("utran-drive.pcap")),
              "operator    Sample Net 262-42 · home network · name from the SIM\n"
              "cell        RNC 167 cell 43037 · PSC 95 · LAC 6699 · 15 s ago · UARFCN 10096\n"
              "            band 34 · 2019.2 MHz\n"
              "levels      RSCP 0.371094\n"
              "state       RRC Cell PCH\n"
              "neighbours  PSC 61 UARFCN 10096 0.394531 · PSC 122 UARFCN 10088 0.343750\n"
              "            PSC 34 UARFCN 10104 0.335938\n"
              "contexts    mms Active\n");
    EXPECT_EQ(lines(sample("cdma-drive.pcap")),
              "1x cell     SID 4139 · NID 65 · base station 2395 · channel 384 · band 0\n"
              "            881.52 MHz\n"
              "EV-DO cell  PN 118 · channel 466 · band 0 · 883.98 MHz\n"
              "levels      profile android · 1x AGC -65.92 dBm excellent\n"
              "            EV-DO AGC -59 dBm excellent · 1x Ec/Io -2.35 dB excellent\n"
              "            EV-DO Ec/Io -3.98 dB\n"
              "state       1x Slotted mode sleep state [7] · EV-DO Connected [5]\n"
              "            EV-DO session Open [4]\n");
    EXPECT_EQ(lines(sample("ifx-stream.pcap")),
              "operator    Sample Net 262-42 · name from the network\n"
              "cell        cell 31004 · BSIC 4,1 · LAC 6701 · ARFCN 85 · band P-GSM 900\n"
              "            952.0 MHz\n"
              "levels      profile android · RxLev -65 dBm excellent\n"
              "state       RR Idle\n"
              "neighbours  ARFCN 71 BSIC 2,5 -79 dBm · ARFCN 62 BSIC 2,3 -89 dBm\n"
              "            ARFCN 17 BSIC 4,2 -92 dBm\n");
}

TEST_F(StatusCommandTest, AtATimeIsInLocalTime) {
    zone.setZone({std::chrono::hours(1), false});
    options.at = time("23:13:30");
    EXPECT_EQ(run(sample("gsm-attach.pcap")), kExitSuccess);
    EXPECT_TRUE(written.starts_with("GSM/UMTS · 2023-11-14 23:13:30 · ")) << written;
}

TEST_F(StatusCommandTest, ATimeThatTheRecordingLacksCannotBeTold) {
    const std::string path = sample("lte-drive.pcap");
    for (const std::string text : {"2020-01-01", "03:00", "-1h", "22:15:21", "+121s",
                                   "2023-11-14T22:15:21", "2023-11-14T22:15:21Z"}) {
        options.at = time(text);
        EXPECT_EQ(run(path), kExitCouldNotTell);
        EXPECT_EQ(reports,
                  std::vector<std::string>{path + ": \"" + text +
                                           "\" is no time of the recording, which lasts from "
                                           "2023-11-14 22:13:20 to 2023-11-14 22:15:19."});
        EXPECT_EQ(written, "");
    }
}

TEST_F(StatusCommandTest, TheEndIsThatOfTheLastPacketWhereTheClockWasSetBack) {
    const std::string path = driveSetBack();
    EXPECT_EQ(run(path), kExitSuccess);
    EXPECT_TRUE(written.starts_with("LTE · 2023-11-14 21:4")) << written;
    const std::string end = written;
    options.at = time("end");
    EXPECT_EQ(run(path), kExitSuccess);
    EXPECT_EQ(written, end);
}

TEST_F(StatusCommandTest, ATimeIsFoundInTheStretchThatHasIt) {
    const std::string path = driveSetBack();
    const auto headAt = [&](std::string_view text) {
        options.at = time(text);
        EXPECT_EQ(run(path), kExitSuccess) << text;
        return written.substr(0, written.find(" · /"));
    };
    EXPECT_EQ(headAt("22:14"), "LTE · 2023-11-14 22:14:00");
    EXPECT_EQ(headAt("21:43:50"), "LTE · 2023-11-14 21:43:50");
    EXPECT_EQ(headAt("2023-11-14T21:43:50"), "LTE · 2023-11-14 21:43:50");
    const std::string head = headAt("-10s");
    EXPECT_TRUE(head.starts_with("LTE · 2023-11-14 21:43:")) << head;
    EXPECT_EQ(headAt("-60s").substr(0, 25), "LTE · 2023-11-14 22:14:5") << "20 s before the step";
    for (const std::string text :
         {"21:43", "2023-11-14T21:43", "22:00", "2023-11-14T22:00", "-161s"}) {
        options.at = time(text);
        EXPECT_EQ(run(path), kExitCouldNotTell) << text;
        EXPECT_EQ(reports,
                  std::vector<std::string>{path + ": \"" + text +
                                           "\" is no time of the recording, which lasts from "
                                           "2023-11-14 21:43:20 to 2023-11-14 22:15:19."});
    }
}

TEST_F(StatusCommandTest, ARecordingThatCannotBeReadCannotBeTold) {
    EXPECT_EQ(run("/no/such.pcap"), kExitCouldNotTell);
    EXPECT_EQ(reports, std::vector<std::string>{
                           "/no/such.pcap cannot be opened: No such file or directory."});
    EXPECT_EQ(run(folder.write("text", "no recording")), kExitCouldNotTell);
}

TEST_F(StatusCommandTest, OfADamagedRecordingIsShownAsFarAsItCanBeRead) {
    const std::string path = folder.file("cut.pcap");
    std::filesystem::copy_file(sample("lte-drive.pcap"), path);
    std::filesystem::resize_file(path, std::filesystem::file_size(path) - 10);
    EXPECT_EQ(run(path), kExitCouldNotTell);
    EXPECT_NE(written.find("PCI 184"), std::string::npos);
    ASSERT_EQ(reports.size(), 1U);
}

TEST_F(StatusCommandTest, OfNothingIsASentence) {
    const std::string empty = folder.write("empty.pcap", "");
    EXPECT_EQ(run(empty), kExitFailure);
    EXPECT_EQ(reports.size(), 1U);
    const std::string header = folder.file("header.pcap");
    std::filesystem::copy_file(sample("lte-drive.pcap"), header);
    constexpr std::size_t kFileHeader = 24;
    std::filesystem::resize_file(header, kFileHeader);
    EXPECT_EQ(run(header), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{header + " holds no packets."});
    const std::string zeros = folder.file("zeros.pcap");
    std::filesystem::copy_file(header, zeros);
    constexpr std::size_t kPacketHeader = 16;
    std::filesystem::resize_file(zeros, kFileHeader + 3 * kPacketHeader);
    EXPECT_EQ(run(zeros), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{zeros + " tells nothing about the radio."});
    options.at = time("start");
    EXPECT_EQ(run(sample("gsm-attach.pcap")), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{sample("gsm-attach.pcap") +
                                                " tells nothing about the radio by then."});
    EXPECT_EQ(written, "");
}

TEST_F(StatusCommandTest, OfASnapshotIsTheLatestDisplay) {
    const auto serving = [](const char* pci) {
        return Dictionary{{"Serving Cell Info", Dictionary{{"Physical Cell ID", pci}}},
                          {"Neighbor Cells List", Array()}};
    };
    const std::string path = snapshot({{"2023-11-14 22:13:20 +0000", serving("182")},
                                       {"2023-11-14 22:13:22 +0000", serving("183")}});
    EXPECT_EQ(run(path), kExitSuccess);
    EXPECT_EQ(written, "LTE · 2023-11-14 22:13:22 · " + path + "\ncell        PCI 183\n");
    options.at = time("22:13:21");
    EXPECT_EQ(run(path), kExitSuccess);
    EXPECT_TRUE(written.ends_with("\ncell        PCI 182\n")) << written;
    EXPECT_EQ(reports, std::vector<std::string>{"Displays that share a section all show it as it "
                                                "was when the snapshot was saved."});
    options.at = time("22:13:22");
    EXPECT_EQ(lines(path), "cell        PCI 183\n") << "of the latest this need not be said";
    options.at = time("2023-11-14T22:13:19");
    EXPECT_EQ(run(path), kExitCouldNotTell);
    EXPECT_EQ(reports, std::vector<std::string>{
                           path + ": \"2023-11-14T22:13:19\" is no time of the recording, which "
                                  "lasts from 2023-11-14 22:13:20 to 2023-11-14 22:13:22."});
    options.at = time("+3s");
    EXPECT_EQ(run(path), kExitCouldNotTell);
    options.at = std::nullopt;
    const std::string without = snapshot({});
    EXPECT_EQ(run(without), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{without + " is a snapshot without displays."});
}

TEST_F(StatusCommandTest, ASnapshotIsReadFromStandardInput) {
    const std::string path =
        snapshot({{"2023-11-14 22:13:20 +0000",
                   {{"Serving Cell Info", Dictionary{{"Physical Cell ID", "182"}}},
                    {"Neighbor Cells List", Array()}}}});
    const std::string shown = "LTE · 2023-11-14 22:13:20 · standard input\ncell        PCI 182\n";
    withInput(path, [&] { EXPECT_EQ(run("-"), kExitSuccess); });
    EXPECT_EQ(written, shown);
    const std::string compressed =
        folder.write("saved.gz", doubles::gzipOf(doubles::contentOf(path)));
    withInput(compressed, [&] { EXPECT_EQ(run("-"), kExitSuccess); });
    EXPECT_EQ(written, shown);
    withInput(snapshot({}), [&] { EXPECT_EQ(run("-"), kExitFailure); });
    EXPECT_EQ(reports, std::vector<std::string>{"standard input is a snapshot without displays."});
    withInput(sample("lte-drive.pcap"), [&] { EXPECT_EQ(run("-"), kExitSuccess); });
    EXPECT_NE(written.find("PCI 184"), std::string::npos);
}

TEST_F(StatusCommandTest, TheTechnologyCanBeNamed) {
    options.technology = technologyOfCommandName("gsm");
    EXPECT_EQ(run(sample("lte-drive.pcap")), kExitSuccess);
    EXPECT_TRUE(written.starts_with("GSM/UMTS")) << written;
}

TEST_F(StatusCommandTest, JsonHasTheFieldsAndTheirTimes) {
    options.json = true;
    EXPECT_EQ(
        run(snapshot(
            {{"2023-11-14 22:13:20 +0000",
              {{"RRC Info", Dictionary{{"State", "Idle"}}},
               {"Serving Cell Info", Dictionary{{"Downlink UARFCN", "10096"}}},
               {"Neighbor Cell List",
                Array{Dictionary{{"UARFCN", "10096"}, {"Cell ID", "5"}, {"Filter RSCP", "0.5"}}}},
               {"SIM Info", Dictionary{{"EF-ACTING HPLMN", "26242"}}},
               {"PDP Context Info", Array{Dictionary{{"APN", "mms"}}}}}}})),
        kExitSuccess);
    const std::string read = R"("quality":null,"read":"2023-11-14T22:13:20.000Z"})";
    EXPECT_EQ(
        written,
        R"({"recording":")" + folder.file("saved.pallax") +
            R"(","time":"2023-11-14T22:13:20.000Z","packet":null,"technology":"utran",)"
            R"("operator":{"mcc":"262","mnc":"42","name":null,"source":null,"country":null,)"
            R"("home":true},"cells":[{"system":"UTRAN","site":null,"identity":[],)"
            R"("channel":{"name":"UARFCN","field":"utran.serving_cell_info.downlink_uarfcn",)"
            R"("text":"10096","number":10096,)" +
            read +
            R"(,"band":"a","mhz":2019.2,"levels":[]}],"profile":"android",)"
            R"("states":[{"name":"RRC","field":"utran.rrc_info.state","text":"Idle","number":null,)" +
            read +
            R"(],"neighbours":[{"system":"UTRAN","cell":"PSC 5 UARFCN 10096",)"
            R"("level":{"name":"RSCP","field":"utran.neighbor_cell_list.filter_rscp",)"
            R"("text":"0.5","number":0.5,)" +
            read + R"(}],"contexts":[{"name":"mms","state":null}]})" + "\n");
}

} // namespace
} // namespace pallax
