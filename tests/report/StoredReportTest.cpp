#include "report/StoredReport.h"

#include "decoding/DisplayJson.h"
#include "report/ReportWalk.h"
#include "store/FileRecordings.h"
#include "store/FileStore.h"
#include "tests/store/StoreFixture.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <fstream>

namespace pallax {
namespace {

using Json = nlohmann::json;

const QualityProfile& android() {
    static const QualityProfile profile = *builtInProfile("android");
    return profile;
}

class StoredReportTest : public StoreFixture {
protected:
    explicit StoredReportTest(std::string_view technologyName = "lte")
        : StoreFixture(technologyName) {}

    StoredReportRequest whole() const {
        StoredReportRequest request;
        request.store = file;
        return request;
    }
    Result<StoredReport, std::string> made(const StoredReportRequest& request) const {
        return storedReport(
            [&] { return std::make_unique<FileRecordings>(request.store); }, request,
            {_names, android(), resources, [](Time /*time*/) { return std::chrono::seconds(0); }});
    }
    Json figures(const StoredReportRequest& request) const {
        const auto report = made(request);
        EXPECT_TRUE(report) << (report ? "" : report.error());
        return report ? Json::parse(report->json) : Json();
    }
    std::string refusal(const StoredReportRequest& request) const {
        const auto report = made(request);
        return report ? "" : report.error();
    }
    /// Those of a report from the recording, without identities.
    Json ofRecording() {
        const auto timeline = indexed();
        ReportBuilder report(_names, android(), [](const auto& /*path*/) { return false; });
        gatherTicks(*timeline, report, [](const TickWalk::State& /*state*/) { return true; });
        report.finish();
        std::string text;
        ReportHead head;
        head.packets = timeline->packets();
        appendJson(text, figuresOf(head, report, timeline->events(), timeline->fields()));
        return Json::parse(text);
    }
    static TimeText time(const char* text) { return *TimeText::parse(text); }

private:
    NetworkNames _names;
};

class StoredReportOf : public StoredReportTest, public testing::WithParamInterface<const char*> {
protected:
    StoredReportOf() : StoredReportTest(GetParam()) {}
};

void expectNear(const Json& one, const Json& other, double most) {
    ASSERT_EQ(one.is_null(), other.is_null());
    if (!one.is_null()) {
        EXPECT_NEAR(one.get<double>(), other.get<double>(), most);
    }
}

/// A store does not tell which of two records of the same tick came last, so levels may differ a
/// little.
void expectSameLevel(const Json& recorded, const Json& stored) {
    for (const char* key : {"system", "name", "unit", "measure", "borders"}) {
        EXPECT_EQ(recorded[key], stored[key]);
    }
    EXPECT_NEAR(recorded["seconds"].get<double>(), stored["seconds"].get<double>(), 4);
    ASSERT_EQ(recorded["shares"].size(), stored["shares"].size());
    for (std::size_t grade = 0; grade < recorded["shares"].size(); ++grade) {
        EXPECT_EQ(recorded["shares"][grade]["grade"], stored["shares"][grade]["grade"]);
        expectNear(recorded["shares"][grade]["share"], stored["shares"][grade]["share"], 0.02);
    }
    ASSERT_EQ(recorded["quantiles"].is_null(), stored["quantiles"].is_null());
    for (const char* key : {"p5", "p50", "p95"}) {
        if (!recorded["quantiles"].is_null()) {
            expectNear(recorded["quantiles"][key], stored["quantiles"][key], 1.5);
        }
    }
}

TEST_P(StoredReportOf, AgreesWithThatOfTheRecording) {
    drive(1, std::chrono::seconds(400));
    ASSERT_EQ(load(write("drive.pcap")).kind, LoadOutcome::Kind::Loaded);
    const Json stored = figures(whole());
    const Json recorded = ofRecording();
    ASSERT_FALSE(recorded["measures"].empty());
    ASSERT_EQ(stored["measures"].size(), recorded["measures"].size());
    for (std::size_t place = 0; place < recorded["measures"].size(); ++place) {
        SCOPED_TRACE(recorded["measures"][place]["name"]);
        expectSameLevel(recorded["measures"][place], stored["measures"][place]);
    }
    ASSERT_EQ(stored["cells"].size(), recorded["cells"].size());
    for (std::size_t place = 0; place < recorded["cells"].size(); ++place) {
        for (const char* key : {"system", "cell", "from", "to", "stretch", "pingPong"}) {
            EXPECT_EQ(stored["cells"][place][key], recorded["cells"][place][key]) << place;
        }
    }
    EXPECT_EQ(stored["states"], recorded["states"]);
    EXPECT_EQ(stored["neighbours"].size(), recorded["neighbours"].size());
    for (const char* key : {"time", "kind", "packet", "stretch"}) {
        ASSERT_EQ(stored["events"].size(), recorded["events"].size());
        for (std::size_t place = 0; place < recorded["events"].size(); ++place) {
            EXPECT_EQ(stored["events"][place][key], recorded["events"][place][key]) << place;
        }
    }
    for (const char* key : {"from", "to", "packets", "ticks", "gaps", "cellChanges", "pingPongs",
                            "stretches", "profile", "operator"}) {
        EXPECT_EQ(stored["head"][key], recorded["head"][key]) << key;
    }
}

INSTANTIATE_TEST_SUITE_P(Technologies, StoredReportOf,
                         testing::Values("gsm", "cdma", "ifx", "lte", "utran"));

TEST_F(StoredReportTest, SaysWhatItIsOfAndWhatAStoreDoesNotHold) {
    drive(1, std::chrono::seconds(60));
    (void)load(write("drive.pcap"));
    StoredReportRequest request = whole();
    request.head.version = "1.2.3";
    const Json head = figures(request)["head"];
    EXPECT_EQ(head["label"], "car1");
    EXPECT_EQ(head["recording"], "drive.pcap");
    EXPECT_EQ(head["technology"], "LTE");
    EXPECT_EQ(head["version"], "1.2.3");
    EXPECT_EQ(head["identities"], "left out");
    EXPECT_EQ(
        head["notes"],
        (Json{"A store does not hold the display: its state at each tick is left out. Levels, "
              "cells, neighbours and states are drawn from the values that it holds.",
              "Contexts are not shown: their names can identify a person, so the store "
              "leaves them out."}));
}

TEST_F(StoredReportTest, IsOfTheTimeThatIsAskedFor) {
    drive(1, std::chrono::seconds(200));
    (void)load(write("drive.pcap"));
    StoredReportRequest request = whole();
    request.from = time("+50s");
    request.to = time("+100s");
    const Json part = figures(request);
    EXPECT_EQ(part["head"]["ticks"], 26);
    for (const Json& event : part["events"]) {
        EXPECT_GE(event["time"].get<double>(), 1'700'000'050);
        EXPECT_LE(event["time"].get<double>(), 1'700'000'101);
    }
    request.from = time("end");
    request.to = time("start");
    EXPECT_EQ(refusal(request), "the time of --from is later than that of --to.");
    request.from = time("2030-01-01T00:00Z");
    request.to.reset();
    EXPECT_EQ(refusal(request), "The store has nothing of car1 in that time.");
}

TEST_F(StoredReportTest, RecordingsFollowEachOtherWithTheTimeBetweenUnknown) {
    drive(1, std::chrono::seconds(60));
    (void)load(write("one.pcap"));
    const Json one = figures(whole());
    MemoryJournal later;
    for (std::uint64_t number = 1; number <= journal.size(); ++number) {
        const JournalPacket packet = journal.packet(number);
        later.add(packet.time + std::chrono::hours(1),
                  ByteBuffer(packet.data.begin(), packet.data.end()));
    }
    journal = later;
    (void)load(write("two.pcap"));
    const Json both = figures(whole());
    EXPECT_EQ(both["head"]["recording"], "2 recordings");
    EXPECT_EQ(both["head"]["packets"], 2 * one["head"]["packets"].get<int>());
    EXPECT_EQ(both["head"]["ticks"], 2 * one["head"]["ticks"].get<int>());
    EXPECT_EQ(both["head"]["stretches"].size(), 1U);
    EXPECT_EQ(both["events"].size(), 2 * one["events"].size());
    EXPECT_EQ(both["measures"][0]["seconds"], 2 * one["measures"][0]["seconds"].get<double>());
    EXPECT_EQ(both["events"].back()["packet"].get<std::uint64_t>(),
              one["events"].back()["packet"].get<std::uint64_t>() + journal.size());
}

TEST_F(StoredReportTest, OfARecordingWithTheValuesOfEachPacketHasTicksToo) {
    drive(1, std::chrono::seconds(60));
    LoadRequest all = request();
    all.resolution = Resolution::Packet;
    (void)load(write("drive.pcap"), all);
    const Json stored = figures(whole());
    const Json recorded = ofRecording();
    EXPECT_NEAR(stored["head"]["ticks"].get<int>(), recorded["head"]["ticks"].get<int>(), 1);
    EXPECT_EQ(stored["cells"].size(), recorded["cells"].size());
    expectNear(stored["measures"][0]["quantiles"]["p50"],
               recorded["measures"][0]["quantiles"]["p50"], 2);
}

TEST_F(StoredReportTest, WhatCannotBeReportedIsASentence) {
    StoredReportRequest request = whole();
    EXPECT_EQ(refusal(request), "There is no store " + file + " (see pallax store load).");
    { const FileStore empty(file); }
    EXPECT_EQ(refusal(request), "The store " + file + " is empty (see pallax store load).");
    drive(1, std::chrono::seconds(10));
    (void)load(write("drive.pcap"));
    request.device = "car2";
    EXPECT_EQ(refusal(request), "The store has no device \"car2\". Did you mean \"car1\"?");
    request.device = "'; drop";
    EXPECT_EQ(refusal(request), "The store has no device \"'; drop\".");
    request.device = "car1";
    request.technology = technologyOfCommandName("gsm");
    EXPECT_EQ(refusal(request), "The store has nothing of car1 in that time.");
    request.store = folder.write("other.db", "text");
    EXPECT_EQ(refusal(request), request.store + " is no file of SQLite.");
}

TEST_F(StoredReportTest, AGapOfWeeksIsPassedAtOnce) {
    drive(1, std::chrono::seconds(10));
    const JournalPacket last = journal.packet(journal.size());
    journal.add(last.time + std::chrono::hours(24 * 50),
                ByteBuffer(last.data.begin(), last.data.end()));
    (void)load(write("drive.pcap"));
    const Json head = figures(whole())["head"];
    EXPECT_EQ(head["gaps"], 1);
    EXPECT_EQ(head["ticks"], ofRecording()["head"]["ticks"]);
}

TEST_F(StoredReportTest, NumbersOfAFileThatNobodyWroteAreASentenceOrAReport) {
    drive(1, std::chrono::seconds(10));
    (void)load(write("drive.pcap"));
    const auto change = [&](const char* sql) {
        FileStore store(file);
        store.connection().run(sql);
    };
    change("UPDATE intervals SET hold = 9000000000000000000 WHERE id % 2");
    change("UPDATE intervals SET time = -9000000000000000000 WHERE id % 3 = 0");
    change("UPDATE events SET time = -9223372036854775807");
    EXPECT_LE(figures(whole())["head"]["ticks"].get<int>(), 20);
    change("UPDATE intervals SET hold = -9000000000000000000");
    change("DELETE FROM sites");
    change("UPDATE series SET step = 'x', format = '%s%n%q', last_row = 9000000000000000000");
    (void)made(whole()); // a report or a sentence, but it ends
    change("UPDATE recordings SET first = -9000000000000000000, last = 9000000000000000000");
    EXPECT_EQ(refusal(whole()), "The recordings of that time last more than 100 days, which is too "
                                "much for a page; choose less with --from and --to.");
}

TEST_F(StoredReportTest, SeveralDevicesMustBeChosenFrom) {
    drive(1, std::chrono::seconds(10));
    (void)load(write("one.pcap"));
    LoadRequest other = request();
    other.device = "car2";
    journal = {};
    drive(2, std::chrono::seconds(10));
    (void)load(write("two.pcap"), other);
    EXPECT_EQ(refusal(whole()),
              "The store has several devices; choose one with --device: car1, car2.");
    StoredReportRequest chosen = whole();
    chosen.device = "car2";
    EXPECT_EQ(figures(chosen)["head"]["label"], "car2");
}

} // namespace
} // namespace pallax
