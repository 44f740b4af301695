#include "web/LiveData.h"

#include "decoding/DisplayJson.h"
#include "tests/timeline/TimelineFixture.h"
#include "web/SeriesJson.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using nlohmann::json;

class LiveDataTest : public testing::Test {
protected:
    LiveDataTest() { recorded.drive(7, 60s); }

    void show(Timeline& timeline) {
        data.begin(&timeline);
        EXPECT_TRUE(data.follow([] { return true; }));
        data.settle();
    }
    json state(Time at) { return json::parse(*data.state(at)); }

    TimelineFixture recorded{"lte"};
    NetworkNames names;
    QualityProfile profile = *builtInProfile(kDefaultProfile);
    LiveData data{{names,
                   profile,
                   recorded.resources,
                   {.title = "", .recording = "drive.pcap", .technology = "", .version = "1.2"}}};
};

TEST_F(LiveDataTest, BeforeAnyPacketThereIsNothing) {
    EXPECT_EQ(data.figures().all(), "{}");
    EXPECT_EQ(data.state(Time(0s)), std::nullopt);
    EXPECT_EQ(data.series({1}, {Time(0s), Time(9000s), 10}), R"({"times":[],"values":[[]]})");
    EXPECT_FALSE(data.status());
    data.settle();
}

TEST_F(LiveDataTest, FiguresAreThoseOfAReport) {
    const auto timeline = recorded.indexed();
    show(*timeline);
    const json figures = json::parse(data.figures().all());
    const json& head = figures["head"];
    EXPECT_EQ(head["recording"], "drive.pcap");
    EXPECT_EQ(head["technology"], "LTE");
    EXPECT_EQ(head["version"], "1.2");
    EXPECT_EQ(head["identities"], "left out");
    EXPECT_EQ(head["packets"], recorded.journal.size());
    EXPECT_EQ(head["ticks"], 30);
    EXPECT_EQ(figures["measures"][0]["name"], "RSRP");
    EXPECT_EQ(figures["events"].size(), timeline->events().size());
}

TEST_F(LiveDataTest, ChangesAreTheMembersThatATickChanges) {
    Timeline timeline(recorded.journal, recorded.source());
    std::uint64_t most = 1000;
    const auto part = [&most, &timeline] { return timeline.packets() < most; };
    (void)timeline.index(part);
    data.begin(&timeline);
    (void)data.follow([] { return true; });
    const JsonMembers before = data.figures();
    EXPECT_EQ(data.figures().changedSince(before), "{}");
    most = 1200;
    (void)timeline.index(part);
    (void)data.follow([] { return true; });
    const json changed = json::parse(data.figures().changedSince(before));
    EXPECT_TRUE(changed.contains("head"));
    EXPECT_TRUE(changed.contains("measures"));
}

TEST_F(LiveDataTest, StatesAreDisplaysAsDecodePrintsThem) {
    const auto timeline = recorded.indexed();
    show(*timeline);
    std::string end;
    appendJson(end, timeline->displayAt(timeline->packets()));
    const Time last = Simulation::kStart + 60s;
    EXPECT_EQ(state(last + 1h)["display"].dump(), json::parse(end).dump());
    EXPECT_EQ(state(last + 1h)["tick"], 30);
    const json first = state(Simulation::kStart - 1h);
    EXPECT_EQ(first["tick"], 1) << "before the first tick, the first";
    EXPECT_EQ(state(Simulation::kStart + 9s)["tick"], 4);
    EXPECT_EQ(state(Simulation::kStart + 9s)["time"],
              pageSeconds(Simulation::kStart + 8s) +
                  (first["time"].get<double>() - pageSeconds(Simulation::kStart + 2s)));
    EXPECT_NE(state(Simulation::kStart + 9s)["display"], first["display"]);
}

TEST_F(LiveDataTest, AStateWhosePacketsAreGoneIsNotKept) {
    recorded.journal.dropBefore(500);
    const auto timeline = recorded.indexed();
    show(*timeline);
    EXPECT_TRUE(data.state(Simulation::kStart + 1h));
    const auto early = data.state(Simulation::kStart);
    EXPECT_TRUE(!early ||
                json::parse(*early)["time"].get<double>() > pageSeconds(Simulation::kStart + 10s));
}

TEST_F(LiveDataTest, SeriesAreNamedByTheFigures) {
    const auto timeline = recorded.indexed();
    show(*timeline);
    const json figures = json::parse(data.figures().all());
    const auto id = figures["measures"][0]["id"].get<std::uint32_t>();
    const json series = json::parse(data.series({id, 9999}, {Time(0s), Time(2000000000s), 1000}));
    EXPECT_EQ(series["times"].size(), 30U);
    EXPECT_EQ(series["values"].size(), 2U);
    EXPECT_FALSE(series["values"][0].back().is_null());
    EXPECT_TRUE(series["values"][1].back().is_null());
}

TEST_F(LiveDataTest, AnotherTimelineBeginsAnew) {
    const auto timeline = recorded.indexed();
    show(*timeline);
    TimelineFixture gsm("gsm");
    gsm.drive(3, 10s);
    const auto other = gsm.indexed();
    show(*other);
    const json head = json::parse(data.figures().all())["head"];
    EXPECT_EQ(head["technology"], "GSM/UMTS");
    EXPECT_EQ(head["ticks"], 5);
    EXPECT_TRUE(data.status());
    data.begin(nullptr);
    EXPECT_EQ(data.figures().all(), "{}");
}

} // namespace
} // namespace pallax
