#include "packets/TimeGrid.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <limits>

namespace pallax {
namespace {

using std::chrono::nanoseconds;
using std::chrono::seconds;

constexpr Time kFirst{seconds(1700000000)};

TEST(TimeGrid, MomentsAreCountedFromOneIntervalAfterTheFirstTime) {
    const TimeGrid grid(kFirst, seconds(2));
    EXPECT_EQ(grid.moment(1), kFirst + seconds(2));
    EXPECT_EQ(grid.moment(5), kFirst + seconds(10));
}

TEST(TimeGrid, AMomentHasPassedAtItsVeryTime) {
    const TimeGrid grid(kFirst, seconds(2));
    EXPECT_EQ(grid.passedAt(kFirst), 0U);
    EXPECT_EQ(grid.passedAt(kFirst + seconds(2) - nanoseconds(1)), 0U);
    EXPECT_EQ(grid.passedAt(kFirst + seconds(2)), 1U);
    EXPECT_EQ(grid.passedAt(kFirst + seconds(11)), 5U);
}

TEST(TimeGrid, NoneHasPassedBeforeTheFirstTime) {
    const TimeGrid grid(kFirst, seconds(2));
    EXPECT_EQ(grid.passedAt(kFirst - seconds(100)), 0U);
    EXPECT_EQ(grid.passedAt(Time::min()), 0U);
    EXPECT_EQ(grid.nextAfter(kFirst - seconds(100)), kFirst + seconds(2));
}

TEST(TimeGrid, TheNextMomentIsNeverTheTimeItself) {
    const TimeGrid grid(kFirst, seconds(2));
    EXPECT_EQ(grid.nextAfter(kFirst), kFirst + seconds(2));
    EXPECT_EQ(grid.nextAfter(kFirst + seconds(2) - nanoseconds(1)), kFirst + seconds(2));
    EXPECT_EQ(grid.nextAfter(kFirst + seconds(2)), kFirst + seconds(4));
}

TEST(TimeGrid, TheWholeRangeOfTimeOverflowsNothing) {
    const TimeGrid fine(Time::min(), nanoseconds(1));
    EXPECT_EQ(fine.passedAt(Time::max()), std::numeric_limits<std::uint64_t>::max());
    EXPECT_EQ(fine.moment(std::numeric_limits<std::uint64_t>::max()), Time::max());
    EXPECT_EQ(fine.moment(1), Time::min() + nanoseconds(1));
    const TimeGrid coarse(Time::min(), nanoseconds::max());
    EXPECT_EQ(coarse.passedAt(Time::max()), 2U);
    EXPECT_EQ(coarse.moment(1), Time(nanoseconds(-1)));
}

TEST(TimeGrid, AMomentBeyondTheRangeIsItsEnd) {
    EXPECT_EQ(TimeGrid(Time::max(), seconds(2)).moment(1), Time::max());
    EXPECT_EQ(TimeGrid(Time::max() - seconds(1), seconds(2)).nextAfter(Time::max()), Time::max());
    EXPECT_EQ(TimeGrid(kFirst, nanoseconds::max()).moment(1000), Time::max());
}

TEST(TimeGrid, GivesWhatSteppingGives) {
    EXPECT_TRUE(doubles::holds([] {
        const auto interval = nanoseconds(doubles::any::between(1, 1000));
        const auto time = kFirst + nanoseconds(doubles::any::between(0, 20000));
        std::uint64_t passed = 0;
        Time next = kFirst + interval;
        for (; next <= time; next += interval) {
            ++passed;
        }
        const TimeGrid grid(kFirst, interval);
        RC_ASSERT(grid.passedAt(time) == passed);
        RC_ASSERT(grid.nextAfter(time) == next);
    }));
}

} // namespace
} // namespace pallax
