#include "ui/contents/ShownValues.h"

#include "tests/timeline/TimelineFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

class ShownValuesTest : public testing::Test {
protected:
    ShownValuesTest() { drive.drive(7, std::chrono::seconds(60)); }

    TimelineFixture drive{"lte"};
    NetworkNames names;
    Moment moment;
    const CurrentValues* current = nullptr;
    DisplayTime displayTime;
    ShownValues shown{{[this] { return moment; }, [this] { return current; },
                       [this]() -> const NetworkNames& { return names; },
                       [this] { return displayTime; }}};
    const LeafName rsrp{"lte.serving_cell_measurements.measured_rsrp", "", ""};
};

TEST_F(ShownValuesTest, AreThoseOfTheInstant) {
    const auto timeline = drive.indexed();
    for (const std::uint64_t instant : {timeline->packets(), timeline->packets() / 2}) {
        moment = {timeline.get(), instant};
        shown.update();
        ASSERT_NE(shown.values(), nullptr);
        EXPECT_EQ(valueOf(*shown.values(), rsrp)->value,
                  valueOf(timeline->valuesAt(instant), rsrp)->value);
        EXPECT_EQ(shown.choose(std::chrono::seconds(10)).lastPacket, instant);
        EXPECT_FALSE(shown.curve(rsrp, 10).points.empty());
        EXPECT_TRUE(shown.curve({"lte.nothing", "", ""}, 10).points.empty());
        EXPECT_TRUE(shown.curve({rsrp.field, "Physical Cell ID 1", ""}, 10).points.empty());
    }
    EXPECT_EQ(shown.time().now, *timeOf(*timeline, moment.instant));
}

TEST_F(ShownValuesTest, AreMissingWhereTheJournalHasDroppedTheInstant) {
    drive.journal.dropBefore(1000);
    const auto timeline = drive.indexed();
    ASSERT_GT(timeline->firstInstant(), 100U);
    moment = {timeline.get(), 100};
    shown.update();
    EXPECT_EQ(shown.values(), nullptr);
    EXPECT_TRUE(shown.choose(std::chrono::seconds(10)).firstPacket > shown.window().lastPacket);
    EXPECT_TRUE(shown.curve(rsrp, 10).points.empty());
}

TEST_F(ShownValuesTest, WithoutATimelineAreTheCurrentOnes) {
    const auto timeline = drive.indexed();
    current = &timeline->latestValues();
    shown.update();
    EXPECT_FALSE(shown.hasTimeline());
    EXPECT_EQ(shown.values(), current);
    EXPECT_EQ(shown.reading(rsrp, *valueOf(*current, rsrp)), nullptr);
    EXPECT_TRUE(shown.curve(rsrp, 10).points.empty());
    EXPECT_TRUE(shown.events().empty());
}

TEST_F(ShownValuesTest, EventsAreThoseOfTheWindow) {
    const auto timeline = drive.indexed();
    moment = {timeline.get(), timeline->packets()};
    shown.update();
    const auto window = shown.choose(std::chrono::seconds(20));
    std::size_t expected = 0;
    for (const Event& event : timeline->events()) {
        expected += event.packet >= window.firstPacket ? 1 : 0;
    }
    EXPECT_GT(expected, 0U);
    EXPECT_LT(expected, timeline->events().size());
    EXPECT_EQ(shown.events().size(), expected);
}

} // namespace
} // namespace pallax
