#include "packets/StampSequence.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using Kind = StampRemark::Kind;

constexpr Time kStart{std::chrono::seconds(1700000000)};

/// A sequence that has taken these stamps, given as times since kStart.
StampSequence sequenceOf(const std::vector<std::chrono::nanoseconds>& stamps) {
    StampSequence sequence;
    for (const auto stamp : stamps) {
        sequence.take(kStart + stamp);
    }
    return sequence;
}

TEST(StampSequence, TheFirstStampStepsNowhere) {
    const StampSequence sequence;
    EXPECT_TRUE(sequence.isEmpty());
    EXPECT_EQ(sequence.stepTo(kStart), std::nullopt);
    EXPECT_FALSE(sequence.wouldStepBack(kStart));
    EXPECT_EQ(sequenceOf({5s}).first(), kStart + 5s);
    EXPECT_EQ(sequenceOf({5s}).latest(), kStart + 5s);
}

TEST(StampSequence, UpToTwoSecondsBackAreOfTheSameStretch) {
    const StampSequence sequence = sequenceOf({0s, 10s});
    EXPECT_EQ(sequence.stepTo(kStart + 8s), std::nullopt);
    EXPECT_EQ(sequence.stepTo(kStart + 8s - 1ns), (StampRemark{Kind::StepBack, 2s + 1ns}));
    EXPECT_EQ(sequenceOf({0s, 10s, 8s}).first(), kStart);
    EXPECT_EQ(sequenceOf({0s, 10s, 8s}).latest(), kStart + 10s);
}

TEST(StampSequence, BeyondThatANewStretchBegins) {
    const StampSequence sequence = sequenceOf({0s, 10s, 5s, 6s});
    EXPECT_EQ(sequence.first(), kStart + 5s);
    EXPECT_EQ(sequence.latest(), kStart + 6s);
}

TEST(StampSequence, MoreThanAMinuteAheadIsAGapOfTheSameStretch) {
    const StampSequence sequence = sequenceOf({0s, 10s});
    EXPECT_EQ(sequence.stepTo(kStart + 70s), std::nullopt);
    EXPECT_EQ(sequence.stepTo(kStart + 70s + 1ns), (StampRemark{Kind::Gap, 60s + 1ns}));
    EXPECT_EQ(sequenceOf({0s, 3600s}).first(), kStart);
}

TEST(StampSequence, StampsThatCreepBackwardsEndTheirStretchToo) {
    StampSequence sequence = sequenceOf({10s, 9s, 8s});
    EXPECT_EQ(sequence.stepTo(kStart + 7s), (StampRemark{Kind::StepBack, 3s}));
}

TEST(StampSequence, TheWholeRangeOfTimeOverflowsNothing) {
    StampSequence sequence;
    sequence.take(Time::min());
    EXPECT_EQ(sequence.stepTo(Time::max()),
              (StampRemark{Kind::Gap, std::chrono::nanoseconds::max()}));
    sequence.take(Time::max());
    EXPECT_EQ(sequence.stepTo(Time::min()),
              (StampRemark{Kind::StepBack, std::chrono::nanoseconds::max()}));
}

TEST(StampSequenceProperty, NoStampOfAStretchLiesFarBeforeTheLatestAndStretchesBeginWhereItDoes) {
    EXPECT_TRUE(doubles::holds([] {
        const auto steps = doubles::any::integers(-5000, 5000);
        StampSequence sequence;
        Time latest = kStart;
        Time first = kStart;
        Time stamp = kStart;
        bool isFirst = true;
        for (const int step : steps) {
            stamp += isFirst ? 0ms : std::chrono::milliseconds(step);
            const bool back = !isFirst && stamp < latest - 2s;
            RC_ASSERT(sequence.wouldStepBack(stamp) == back);
            const auto told = sequence.stepTo(stamp);
            RC_ASSERT(told.has_value() == back); // no gaps, because the steps are short
            if (told) {
                RC_ASSERT(told->size == latest - stamp);
            }
            first = back ? stamp : first;
            latest = back ? stamp : std::max(latest, stamp);
            sequence.take(stamp);
            isFirst = false;
            RC_ASSERT(sequence.first() == first);
            RC_ASSERT(sequence.latest() == latest);
        }
    }));
}

} // namespace
} // namespace pallax
