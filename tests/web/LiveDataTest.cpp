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
    static json jsonOf(const PropertyList& value) {
        std::string text;
        appendJson(text, value);
        return json::parse(text);
    }
    json state(Time at) { return json::parse(*data.state(at, 0)); }

    TimelineFixture recorded{"lte"};
    NetworkNames names;
    QualityProfile profile = *builtInProfile(kDefaultProfile);
    LiveData data{{names,
                   profile,
                   recorded.resources,
                   {.title = "",
                    .recording = "drive.pcap",
                    .technology = "",
                    .version = "1.2",
                    .hasIdentities = true}}};
};

TEST_F(LiveDataTest, BeforeAnyPacketThereIsNothing) {
    EXPECT_EQ(jsonOf(data.figures()), json::object());
    EXPECT_EQ(data.state(Time(0s), 0), std::nullopt);
    EXPECT_EQ(data.series({1}, {Time(0s), Time(9000s), 10}, 0), R"({"times":[],"values":[[]]})");
    EXPECT_FALSE(data.status());
    data.settle();
}

TEST_F(LiveDataTest, FiguresAreThoseOfAReport) {
    const auto timeline = recorded.indexed();
    show(*timeline);
    const json figures = jsonOf(data.figures());
    const json& head = figures["head"];
    EXPECT_EQ(head["recording"], "drive.pcap");
    EXPECT_EQ(head["technology"], "LTE");
    EXPECT_EQ(head["version"], "1.2");
    EXPECT_EQ(head["identities"], "included");
    EXPECT_EQ(head["packets"], recorded.journal.size());
    EXPECT_EQ(head["ticks"], 30);
    EXPECT_EQ(figures["measures"][0]["name"], "RSRP");
    EXPECT_EQ(figures["events"].size(), timeline->events().size());
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

TEST_F(LiveDataTest, WhatIsMaskedIsLeftOut) {
    LiveData masked{{names, profile, recorded.resources, ReportHead()}};
    const auto timeline = recorded.indexed();
    masked.begin(timeline.get());
    EXPECT_TRUE(masked.follow([] { return true; }));
    EXPECT_EQ(jsonOf(masked.figures())["head"]["identities"], "left out");
    const json sim = json::parse(*masked.state(Simulation::kStart + 1h, 0))["display"]["SIM Info"];
    EXPECT_EQ(sim["EF-ICCID"], "left out");
    EXPECT_EQ(sim["EF-MSISDN"], "left out");
    EXPECT_EQ(sim["EF-LOCI"], "left out");
    EXPECT_EQ(sim["EF-PLMN NETWORK NAME"], "Sample Net");
}

TEST_F(LiveDataTest, WherePacketsAreGoneTheFirstStateThatIsKeptIsShown) {
    Timeline timeline(recorded.journal, recorded.source(), {.keyFrames = {.distance = 100}});
    const std::uint64_t half = recorded.journal.size() / 2;
    (void)timeline.index([&] { return timeline.packets() < half; });
    show(timeline);
    EXPECT_EQ(state(Simulation::kStart)["tick"], 1);
    recorded.journal.dropBefore(half);
    (void)timeline.index([] { return true; });
    (void)data.follow([] { return true; });
    data.settle();
    const json earliest = state(Simulation::kStart);
    EXPECT_GT(earliest["tick"], 10);
    EXPECT_LT(earliest["tick"], 20);
    EXPECT_EQ(state(Simulation::kStart + 1h)["tick"], 30);
}

TEST_F(LiveDataTest, WhereNoPacketIsKeptThereIsNoState) {
    Timeline timeline(recorded.journal, recorded.source());
    const std::uint64_t half = recorded.journal.size() / 2;
    (void)timeline.index([&] { return timeline.packets() < half; });
    show(timeline);
    recorded.journal.dropBefore(half);
    (void)timeline.index([] { return true; });
    EXPECT_EQ(data.state(Simulation::kStart, 0), std::nullopt);
    EXPECT_EQ(data.state(Simulation::kStart + 1h, 0), std::nullopt);
}

TEST_F(LiveDataTest, SeriesAreNamedByTheFigures) {
    const auto timeline = recorded.indexed();
    show(*timeline);
    const json figures = jsonOf(data.figures());
    const auto id = figures["measures"][0]["id"].get<std::uint32_t>();
    const json series =
        json::parse(data.series({id, 9999}, {Time(0s), Time(2000000000s), 1000}, 0));
    EXPECT_EQ(series["times"].size(), 30U);
    EXPECT_EQ(series["values"].size(), 2U);
    EXPECT_FALSE(series["values"][0].back().is_null());
    EXPECT_TRUE(series["values"][1].back().is_null());
}

TEST_F(LiveDataTest, WhereTheClockWasSetBackEachStretchHasItsOwn) {
    recorded.drive(9, 20s); // begins at the same time again
    const auto timeline = recorded.indexed();
    show(*timeline);
    const json figures = jsonOf(data.figures());
    ASSERT_EQ(figures["head"]["stretches"].size(), 2U);
    EXPECT_EQ(data.latestStretch(), 1U);
    const auto tickAt = [this](Time at, std::size_t stretch) {
        return json::parse(*data.state(at, stretch))["tick"].get<int>();
    };
    EXPECT_EQ(tickAt(Simulation::kStart + 9s, 0), 4);
    EXPECT_GT(tickAt(Simulation::kStart + 9s, 1), 30);
    EXPECT_EQ(tickAt(Simulation::kStart - 1h, 1), tickAt(Simulation::kStart + 2500ms, 1));
    EXPECT_EQ(data.state(Simulation::kStart, 2), std::nullopt);
    const auto timesOf = [this](std::size_t stretch) {
        return json::parse(data.series({1}, {Time(0s), Time(2000000000s), 1000}, stretch))["times"];
    };
    EXPECT_EQ(timesOf(0).size(), figures["head"]["stretches"][0]["ticks"]);
    EXPECT_EQ(timesOf(1).size(), figures["head"]["stretches"][1]["ticks"]);
    EXPECT_EQ(timesOf(2).size(), 0U);
}

TEST_F(LiveDataTest, AnotherTimelineBeginsAnew) {
    const auto timeline = recorded.indexed();
    show(*timeline);
    TimelineFixture gsm("gsm");
    gsm.drive(3, 10s);
    const auto other = gsm.indexed();
    show(*other);
    const json head = jsonOf(data.figures())["head"];
    EXPECT_EQ(head["technology"], "GSM/UMTS");
    EXPECT_EQ(head["ticks"], 5);
    EXPECT_TRUE(data.status());
    data.begin(nullptr);
    EXPECT_EQ(jsonOf(data.figures()), json::object());
}

} // namespace
} // namespace pallax
