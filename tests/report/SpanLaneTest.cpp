#include "report/SpanLane.h"

#include "tests/report/TestTime.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(SpanLane, JoinsTheSameTextAndEndsAtAnother) {
    SpanLane lane;
    lane.add({at(0), at(2), "Idle", 0});
    lane.add({at(2), at(4), "Idle", 0});
    lane.add({at(4), at(6), "Connected", 0});
    ASSERT_EQ(lane.spans().size(), 2U);
    EXPECT_EQ(lane.spans()[0].from, at(0));
    EXPECT_EQ(lane.spans()[0].to, at(4));
    EXPECT_EQ(lane.spans()[0].text, "Idle");
    EXPECT_EQ(lane.spans()[1].text, "Connected");
}

TEST(SpanLane, HasNothingWhereThereIsNoTextOrTimeIsMissing) {
    SpanLane lane;
    lane.add({at(0), at(2), "Active", 0});
    lane.add({at(2), at(4), "", 0});
    lane.add({at(4), at(6), "Active", 0});
    lane.add({at(20), at(22), "Active", 0});
    ASSERT_EQ(lane.spans().size(), 3U);
    EXPECT_EQ(lane.spans()[0].to, at(2));
    EXPECT_EQ(lane.spans()[1].from, at(4));
    EXPECT_EQ(lane.spans()[1].to, at(6));
    EXPECT_EQ(lane.spans()[2].from, at(20));
}

TEST(SpanLane, BeginsANewSpanWhereTheClockWasSetBack) {
    SpanLane lane;
    lane.add({at(100), at(102), "Idle", 0});
    lane.add({at(10), at(12), "Idle", 1});
    ASSERT_EQ(lane.spans().size(), 2U);
    EXPECT_EQ(lane.spans()[1].from, at(10));
}

TEST(SpanLane, KeepsABoundedNumber) {
    SpanLane lane;
    for (int i = 0; i < static_cast<int>(SpanLane::kMostSpans) + 10; ++i) {
        lane.add({at(i), at(i + 1), std::to_string(i), 0});
    }
    EXPECT_EQ(lane.spans().size(), SpanLane::kMostSpans);
    EXPECT_EQ(lane.spans().back().to, at(static_cast<int>(SpanLane::kMostSpans)))
        << "what is left out does not make the last one longer";
}

} // namespace
} // namespace pallax
