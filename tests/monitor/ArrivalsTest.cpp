#include "monitor/Arrivals.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using namespace doubles; // NOLINT: the vocabulary of these tests
using std::chrono::nanoseconds;

constexpr Time kArrivalsStart{std::chrono::hours(480000)};

Arrivals after(std::initializer_list<std::chrono::seconds> times) {
    Arrivals arrivals;
    for (const auto time : times) {
        arrivals.note(kArrivalsStart + time);
    }
    return arrivals;
}

TEST(Arrivals, BeforeFourNothingIsOverdue) {
    EXPECT_EQ(after({}).patience(), std::nullopt);
    EXPECT_EQ(after({}).median(), std::nullopt);
    EXPECT_EQ(after({0s}).median(), std::nullopt);
    EXPECT_EQ(after({0s, 10s, 20s}).patience(), std::nullopt);
    EXPECT_EQ(after({0s, 10s, 20s, 30s}).patience(), 30s);
    EXPECT_EQ(after({0s, 10s, 20s, 20s}).patience(), std::nullopt) << "that is one arrival";
}

TEST(Arrivals, FourSecondsAreTheLeastPatience) {
    EXPECT_EQ(after({0s, 1s, 2s, 3s}).patience(), 4s);
    EXPECT_EQ(after({0s, 1s, 3s, 5s}).patience(), 6s);
}

TEST(Arrivals, AClockThatWasSetBackGivesNoInterval) {
    Arrivals arrivals = after({0s, 2s, 4s, 6s});
    arrivals.note(kArrivalsStart - 100s);
    EXPECT_EQ(arrivals.last(), kArrivalsStart - 100s);
    EXPECT_EQ(arrivals.median(), 2s);
    arrivals.note(kArrivalsStart - 97s);
    EXPECT_EQ(arrivals.median(), 2s);
    EXPECT_EQ(after({0s, 5s, 3s}).median(), 5s);
}

/// Sorts all intervals that count.
std::optional<nanoseconds> naiveMedian(const std::vector<int>& steps) {
    std::vector<nanoseconds> latest;
    for (auto step = steps.rbegin(); step != steps.rend() && latest.size() < 16; ++step) {
        if (*step > 0) {
            latest.emplace_back(*step);
        }
    }
    std::sort(latest.begin(), latest.end());
    const std::size_t count = latest.size();
    if (count == 0) {
        return std::nullopt;
    }
    return (latest[(count - 1) / 2] + latest[count / 2]) / 2;
}

TEST(Arrivals, TheMedianIsThatOfTheSortedIntervals) {
    EXPECT_TRUE(holds([] {
        const std::vector<int> steps = any::integers(-5, 50);
        Arrivals arrivals;
        Time time = kArrivalsStart;
        arrivals.note(time);
        for (const int step : steps) {
            time += nanoseconds(step);
            arrivals.note(time);
        }
        RC_ASSERT(arrivals.median() == naiveMedian(steps));
        RC_ASSERT(arrivals.last() == time);
        RC_CLASSIFY(steps.size() > Arrivals::kKept, "more than are kept");
    }));
}

} // namespace
} // namespace pallax
