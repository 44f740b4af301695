#include "report/WorstMinute.h"

#include "tests/report/TestTime.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(WorstMinute, HasTheLeastMeanOfAllMinutes) {
    WorstMinute worst;
    for (int second = 0; second < 300; second += 2) {
        worst.add(at(second), 2, second >= 100 && second < 160 ? -110 : -80, 0);
    }
    ASSERT_TRUE(worst.found());
    EXPECT_EQ(worst.found()->from, at(100));
    EXPECT_EQ(worst.found()->to, at(160));
    EXPECT_EQ(worst.found()->mean, -110);
}

TEST(WorstMinute, HasTheGreatestMeanWhereSmallerIsBetter) {
    WorstMinute worst(true);
    for (int second = 0; second < 180; second += 2) {
        worst.add(at(second), 2, second < 60 ? 6 : 1, 0);
    }
    ASSERT_TRUE(worst.found());
    EXPECT_EQ(worst.found()->from, at(0));
    EXPECT_EQ(worst.found()->mean, 6);
}

TEST(WorstMinute, IsNoShorterTime) {
    WorstMinute worst;
    for (int second = 0; second < 44; second += 2) {
        worst.add(at(second), 2, -80, 0);
    }
    EXPECT_FALSE(worst.found());
    worst.add(at(44), 2, -80, 0);
    EXPECT_TRUE(worst.found()) << "most of a minute is enough";
}

TEST(WorstMinute, DoesNotReachOverAStepOfTheClock) {
    WorstMinute worst;
    for (int second = 0; second < 40; second += 2) {
        worst.add(at(second), 2, -120, 0);
    }
    worst.restart();
    for (int second = 0; second < 40; second += 2) {
        worst.add(at(second), 2, -120, 0);
    }
    EXPECT_FALSE(worst.found());
}

} // namespace
} // namespace pallax
