#include "reporting/ReportCommand.h"

#include "tests/inspecting/InspectingFixture.h"
#include "tests/report/PageReading.h"

#include <nlohmann/json.hpp>

#include <fstream>
#include <map>

namespace pallax {
namespace {

using nlohmann::json;

class ReportCommandTest : public InspectingFixture {
protected:
    /// Nothing if there is no report.
    std::optional<std::string> make(const std::vector<std::string>& recordings) {
        options.recordings = recordings;
        reports.clear();
        const ReportCommand::Environment environment{
            decoder,
            names,
            profile,
            zone,
            [this](const std::string& sentence) { reports.push_back(sentence); },
            [this](std::string_view doing, std::uint64_t packets) {
                progress[std::string(doing)] = packets;
            }};
        return ReportCommand(options, environment).make(status);
    }
    json figures(const std::string& recording) {
        options.json = true;
        const auto text = make({recording});
        EXPECT_TRUE(text) << (reports.empty() ? "" : reports.front());
        EXPECT_EQ(status, kExitSuccess);
        return text ? json::parse(*text) : json();
    }
    std::string file(const std::string& name, const std::string& content) {
        const std::string path = folder.file(name);
        std::ofstream(path) << content;
        return path;
    }

    std::map<std::string, std::uint64_t> progress; ///< the latest
    ReportOptions options;
    ExitStatus status = kExitSuccess;
    NetworkNames names;
    QualityProfile profile = *builtInProfile(kDefaultProfile);
};

TEST_F(ReportCommandTest, OfASampleHasItsFigures) {
    const json report = figures(sample("lte-drive.pcap"));
    const json& head = report["head"];
    EXPECT_EQ(head["recording"], "lte-drive.pcap") << "without its folder";
    EXPECT_EQ(head["technology"], "LTE");
    EXPECT_EQ(head["operator"], "Sample Net 262-42");
    EXPECT_EQ(head["packets"], 1200);
    EXPECT_EQ(head["ticks"], 60);
    EXPECT_EQ(head["cellChanges"], 5);
    EXPECT_EQ(head["identities"], "left out");
    ASSERT_EQ(report["measures"].size(), 2U);
    EXPECT_EQ(report["measures"][0]["name"], "RSRP");
    EXPECT_EQ(report["measures"][0]["quantiles"],
              json::parse(R"({"p5":-96.25,"p50":-88.75,"p95":-80,"least":-97.5,"most":-77.5})"));
    std::vector<std::string> cells;
    for (const json& stay : report["cells"]) {
        cells.push_back(stay["cell"]);
    }
    EXPECT_EQ(cells, (std::vector<std::string>{"PCI 182", "PCI 183", "PCI 285", "PCI 82", "PCI 286",
                                               "PCI 184"}));
}

TEST_F(ReportCommandTest, TellsHowFarItIs) {
    ASSERT_TRUE(make({sample("lte-drive.pcap")}));
    EXPECT_EQ(progress,
              (std::map<std::string, std::uint64_t>{{"gathering", 1200}, {"reading", 1199}}));
}

TEST_F(ReportCommandTest, LeavesOutWhatIdentifiesAPerson) {
    const std::string iccid = "89490200001234567890";
    const auto page = make({sample("lte-drive.pcap")});
    ASSERT_TRUE(page);
    const std::string content = pageContent(*page, "figures-0");
    EXPECT_NE(content.find("\"identities\":\"left out\""), std::string::npos);
    EXPECT_NE(content.find("EF-ICCID"), std::string::npos) << "the field is there";
    EXPECT_NE(content.find("\"left out\""), std::string::npos);
    EXPECT_EQ(content.find("\"0000"), std::string::npos) << "no zeros stand for it";
    EXPECT_NE(content.find("\"context up\""), std::string::npos) << "without its name";
    for (const char* identity : {"89490200001234567890", "+4915112345678", "10.17.4.21"}) {
        EXPECT_EQ(content.find(identity), std::string::npos) << identity;
    }
    options.withIdentities = true;
    const auto open = make({sample("lte-drive.pcap")});
    ASSERT_TRUE(open);
    const std::string all = pageContent(*open, "figures-0");
    EXPECT_NE(all.find("\"identities\":\"included\""), std::string::npos);
    EXPECT_NE(all.find(iccid), std::string::npos);
}

TEST_F(ReportCommandTest, TheSameInputGivesTheSameBytes) {
    for (const char* name : {"lte-drive.pcap", "umts-drive.pcap", "cdma-drive.pcap",
                             "utran-drive.pcap", "ifx-stream.pcap"}) {
        const auto page = make({sample(name)});
        ASSERT_TRUE(page) << name;
        EXPECT_EQ(make({sample(name)}), page) << name;
    }
}

TEST_F(ReportCommandTest, NamesTheDeviceOfEachRecording) {
    options.labels = {"phone A", "phone B"};
    const auto page = make({sample("lte-drive.pcap"), sample("umts-drive.pcap")});
    ASSERT_TRUE(page);
    EXPECT_EQ(json::parse(pageContent(*page, "figures-0"))["figures"]["head"]["label"], "phone A");
    EXPECT_EQ(json::parse(pageContent(*page, "figures-1"))["figures"]["head"]["label"], "phone B");
    EXPECT_FALSE(make({sample("lte-drive.pcap")}));
    EXPECT_EQ(status, kExitWrongUsage);
    EXPECT_EQ(reports, std::vector<std::string>{
                           "--label is for one recording each (see pallax report --help)"});
}

TEST_F(ReportCommandTest, HasAPartOfTheTime) {
    options.from = time("22:14:00");
    options.to = time("22:15:00");
    const json report = figures(sample("lte-drive.pcap"));
    EXPECT_EQ(report["head"]["ticks"], 30);
    EXPECT_EQ(report["head"]["from"], 1700000040.036);
    for (const json& event : report["events"]) {
        EXPECT_GE(event["time"], 1700000040.0);
        EXPECT_LE(event["time"], 1700000100.0);
    }
    EXPECT_EQ(report["events"].size(), 5U);
}

TEST_F(ReportCommandTest, HasTheTicksForWhichAConditionHolds) {
    const auto all = figures(sample("lte-drive.pcap"))["head"]["ticks"].get<int>();
    options.where = "measured_rsrp < -90";
    const json report = figures(sample("lte-drive.pcap"));
    EXPECT_EQ(report["head"]["where"], "measured_rsrp < -90");
    EXPECT_GT(report["head"]["ticks"], 0);
    EXPECT_LT(report["head"]["ticks"], all);
    options.where = "measured_rsrp <";
    EXPECT_FALSE(make({sample("lte-drive.pcap")}));
    EXPECT_EQ(status, kExitWrongUsage);
    ASSERT_EQ(reports.size(), 1U);
    EXPECT_TRUE(reports[0].starts_with("--where: ")) << reports[0];
    options.where = "measured_rsrp > 0";
    EXPECT_FALSE(make({sample("lte-drive.pcap")}));
    EXPECT_EQ(status, kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{"lte-drive.pcap shows nothing in that time."});
}

TEST_F(ReportCommandTest, ComparesTwoRecordingsAndNoMore) {
    const auto page = make({sample("lte-drive.pcap"), sample("umts-drive.pcap")});
    ASSERT_TRUE(page);
    EXPECT_EQ(json::parse(pageContent(*page, "figures-0"))["figures"]["head"]["technology"], "LTE");
    EXPECT_EQ(json::parse(pageContent(*page, "figures-1"))["figures"]["head"]["technology"],
              "GSM/UMTS");
    EXPECT_FALSE(
        make({sample("lte-drive.pcap"), sample("umts-drive.pcap"), sample("cdma-drive.pcap")}));
    EXPECT_EQ(status, kExitWrongUsage);
    EXPECT_EQ(reports,
              std::vector<std::string>{
                  "report takes one recording, or two to compare (see pallax report --help)"});
}

TEST_F(ReportCommandTest, HasAStretchForEachTimeThatTheClockWasSetBack) {
    const json report = figures(driveSetBack());
    ASSERT_EQ(report["head"]["stretches"].size(), 2U);
    EXPECT_EQ(report["head"]["stretches"][0]["ticks"], 60);
    EXPECT_LT(report["head"]["stretches"][1]["from"], report["head"]["stretches"][0]["from"]);
    EXPECT_EQ(report["head"]["timeSteps"], 1);
    for (const json& event : report["events"]) {
        EXPECT_EQ(event["stretch"], event["packet"] > 1200 ? 1 : 0) << event;
    }
    EXPECT_EQ(report["cells"].front()["stretch"], 0);
    EXPECT_EQ(report["cells"].back()["stretch"], 1);
}

TEST_F(ReportCommandTest, DrawsATrack) {
    options.track = file("way.gpx", "<gpx><trk><trkseg><trkpt lat=\"50.5\" lon=\"7.25\">"
                                    "<time>2023-11-14T22:13:22Z</time></trkpt></trkseg></trk>"
                                    "</gpx>");
    const auto page = make({sample("lte-drive.pcap")});
    ASSERT_TRUE(page);
    EXPECT_EQ(pageContent(*page, "track"), "[[1700000002,50.5,7.25]]");
    options.track = file("way.gpx", "none");
    EXPECT_FALSE(make({sample("lte-drive.pcap")}));
    EXPECT_EQ(status, kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{options.track +
                                                " cannot be used as a track: it is no XML."});
}

TEST_F(ReportCommandTest, RefusesATrackOfAnotherTime) {
    for (const char* time :
         {"2023-11-13T22:13:22Z", "2023-11-14T22:13:11Z", "2023-11-14T22:15:21Z"}) {
        options.track = file("way.gpx", std::string("<gpx><trk><trkseg><trkpt lat=\"50.5\" ") +
                                            "lon=\"7.25\"><time>" + time +
                                            "</time></trkpt></trkseg></trk></gpx>");
        EXPECT_FALSE(make({sample("lte-drive.pcap")})) << time;
        EXPECT_EQ(status, kExitFailure);
        EXPECT_EQ(reports, std::vector<std::string>{options.track +
                                                    " cannot be used as a track: none of its "
                                                    "points is in the time of the report."});
    }
}

TEST_F(ReportCommandTest, OfADamagedRecordingSaysWhereAndNamesNoFolder) {
    std::string drive = doubles::contentOf(sample("lte-drive.pcap"));
    const std::string cut = file("cut.pcap", drive.substr(0, drive.size() / 2));
    options.json = true;
    const auto report = make({cut});
    ASSERT_TRUE(report);
    EXPECT_EQ(status, kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{cut + " ends in the middle of a packet."});
    EXPECT_EQ(json::parse(*report)["head"]["notes"],
              json::array({"cut.pcap ends in the middle of a packet."}));
    constexpr std::size_t kLengthOfFirst = 24 + 8;
    drive.replace(kLengthOfFirst, 4, "\xFF\xFF\xFF\x7F");
    const std::string damaged = file("damaged.pcap", drive);
    EXPECT_FALSE(make({damaged}));
    EXPECT_EQ(status, kExitFailure);
    ASSERT_EQ(reports.size(), 1U) << "not that there are no packets, too";
    EXPECT_TRUE(reports[0].starts_with(damaged + " cannot be read further: ")) << reports[0];
}

TEST_F(ReportCommandTest, OfASnapshotIsNone) {
    const std::string saved = snapshot({{"2023-11-14 22:13:20", Dictionary{{"A", "1"}}}});
    EXPECT_FALSE(make({saved}));
    EXPECT_EQ(status, kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{
                           saved + " is a snapshot, which holds a few displays and no packets."});
}

TEST_F(ReportCommandTest, WhatCannotBeReadIsOneSentence) {
    EXPECT_FALSE(make({folder.file("none.pcap")}));
    EXPECT_EQ(status, kExitFailure);
    EXPECT_EQ(reports.size(), 1U);
}

TEST_F(ReportCommandTest, ATextFromAModemIsNeverMarkup) {
    const auto page = make({sample("ifx-stream.pcap")});
    options.title = "</script><script>alert(1)</script>";
    const auto titled = make({sample("ifx-stream.pcap")});
    ASSERT_TRUE(page && titled);
    EXPECT_EQ(titled->find("alert(1)"), std::string::npos);
    EXPECT_NE(pageContent(*titled, "figures-0").find("alert(1)"), std::string::npos);
}

} // namespace
} // namespace pallax
