#include "timeline/Curve.h"

#include "tests/timeline/TimelineFixture.h"
#include "timeline/Series.h"

#include <gtest/gtest.h>

#include <cmath>

namespace pallax {
namespace {

class CurveTest : public testing::Test {
protected:
    CurveTest() {
        fixture.drive(7, std::chrono::seconds(60));
        timeline = fixture.indexed();
    }
    Curve curve(const Timeline::Limits& limits, std::optional<std::chrono::seconds> span,
                std::size_t count) {
        timeline = fixture.indexed(limits);
        const auto window = windowUntil(*timeline, timeline->packets(), span);
        return readCurve(*timeline, rsrp(), kNoEntry, window, count);
    }
    FieldIndex rsrp() const {
        return *timeline->fields().named("lte.serving_cell_measurements.measured_rsrp");
    }
    /// Cells so large that they do not suffice for a curve of a short time.
    static Timeline::Limits fewCells() {
        Timeline::Limits limits = TimelineFixture::closeKeyFrames();
        limits.series.cells = 64;
        return limits;
    }

    TimelineFixture fixture{"lte"};
    std::unique_ptr<Timeline> timeline;
};

TEST_F(CurveTest, AWindowEndsAtItsInstantAndHasTheWantedLength) {
    const std::uint64_t instant = timeline->packets() / 2;
    const auto window = windowUntil(*timeline, instant, std::chrono::seconds(10));
    EXPECT_EQ(window.lastPacket, instant);
    EXPECT_EQ(window.to, timeOf(*timeline, instant));
    EXPECT_EQ(window.from, window.to - std::chrono::seconds(10));
    EXPECT_GT(*timeOf(*timeline, window.firstPacket), window.from);
    EXPECT_LE(*timeOf(*timeline, window.firstPacket - 1), window.from);
    const auto all = windowUntil(*timeline, instant, std::nullopt);
    EXPECT_EQ(all.firstPacket, 1U);
    EXPECT_EQ(all.from, timeOf(*timeline, 1));
    const auto longer = windowUntil(*timeline, instant, std::chrono::seconds(600));
    EXPECT_EQ(longer.firstPacket, 1U);
    EXPECT_EQ(longer.from, window.to - std::chrono::seconds(600));
}

TEST_F(CurveTest, AnInstantWithoutAPacketHasNoWindow) {
    const auto window = windowUntil(*timeline, 0, std::chrono::seconds(10));
    EXPECT_GT(window.firstPacket, window.lastPacket);
    EXPECT_TRUE(readCurve(*timeline, rsrp(), kNoEntry, window, 10).points.empty());
    EXPECT_FALSE(timeOf(*timeline, timeline->packets() + 1));
}

TEST_F(CurveTest, HasEachReadingOfAShortTime) {
    for (const auto& limits : {TimelineFixture::closeKeyFrames(), fewCells()}) {
        const Curve read = curve(limits, std::chrono::seconds(20), 100);
        const auto window = windowUntil(*timeline, timeline->packets(), std::chrono::seconds(20));
        const auto expected =
            readSeries(*timeline, rsrp(), kNoEntry, window.firstPacket, window.lastPacket);
        ASSERT_EQ(read.points.size(), expected.size());
        ASSERT_GT(expected.size(), 10U);
        for (std::size_t index = 0; index < expected.size(); ++index) {
            EXPECT_EQ(read.points[index].last, expected[index].value.number);
            EXPECT_EQ(read.points[index].time, expected[index].time);
        }
        EXPECT_FALSE(read.isReduced);
        EXPECT_EQ(read.gap, std::chrono::seconds(10));
    }
}

TEST_F(CurveTest, OfManyPacketsTheLeastAndGreatestNumbersRemain) {
    const Curve read = curve(fewCells(), std::nullopt, 10);
    EXPECT_TRUE(read.isReduced);
    double least = INFINITY;
    double most = -INFINITY;
    for (const SeriesPoint& point :
         readSeries(*timeline, rsrp(), kNoEntry, 1, timeline->packets())) {
        least = std::min(least, point.value.number);
        most = std::max(most, point.value.number);
    }
    double curveLeast = INFINITY;
    double curveMost = -INFINITY;
    for (const CurvePoint& point : read.points) {
        curveLeast = std::min(curveLeast, point.least);
        curveMost = std::max(curveMost, point.most);
    }
    EXPECT_LE(read.points.size(), 64U);
    EXPECT_EQ(curveLeast, least);
    EXPECT_EQ(curveMost, most);
}

TEST_F(CurveTest, TextsAreNoPoints) {
    const auto window = windowUntil(*timeline, timeline->packets(), std::nullopt);
    std::size_t texts = 0;
    for (FieldIndex field = 0; field < timeline->fields().size(); ++field) {
        const FieldValue* value = timeline->latestValues().value(field);
        if (value != nullptr && std::isnan(value->number)) {
            ++texts;
            EXPECT_TRUE(readCurve(*timeline, field, kNoEntry, window, 100).points.empty());
        }
    }
    EXPECT_GT(texts, 0U);
}

TEST(CurveWindow, DoesNotReachBeyondAStepOfTheClock) {
    TimelineFixture fixture("lte");
    fixture.drive(7, std::chrono::seconds(20));
    const std::uint64_t first = fixture.journal.size();
    fixture.drive(8, std::chrono::seconds(20)); // begins at the same time
    const auto timeline = fixture.indexed();
    const auto window = windowUntil(*timeline, timeline->packets(), std::nullopt);
    EXPECT_EQ(window.firstPacket, first + 1);
    EXPECT_EQ(windowUntil(*timeline, first, std::nullopt).firstPacket, 1U);
}

} // namespace
} // namespace pallax
