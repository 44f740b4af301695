#include "ui/contents/Axes.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax {
namespace {

using std::chrono::hours;
using std::chrono::minutes;
using std::chrono::seconds;

constexpr Time kStart{seconds(1700000000)}; // 22:13:20

std::string labelsOf(double least, double most, int count) {
    const ValueAxis axis = valueAxis(least, most, count);
    EXPECT_LE(axis.least, least);
    EXPECT_GE(axis.most, most);
    std::string text;
    for (const double label : axis.labels) {
        text += (text.empty() ? "" : " ") + axis.textOf(label);
    }
    return text;
}

std::string timesOf(seconds span, int columns, seconds ahead = {}) {
    std::string text;
    for (const TimeLabel& label : timeLabels(kStart, kStart + span, ahead, columns)) {
        text += (text.empty() ? "" : " ") + label.text;
    }
    return text;
}

TEST(ValueAxis, HasRoundLabels) {
    EXPECT_EQ(labelsOf(-101.5, -82.25, 3), "-120 -100 -80");
    EXPECT_EQ(labelsOf(-101.5, -82.25, 4), "-110 -100 -90 -80");
    EXPECT_EQ(labelsOf(-10.25, -9.5, 5), "-10.5 -10.0 -9.5");
    EXPECT_EQ(labelsOf(0, 5, 3), "0 5");
    EXPECT_EQ(labelsOf(3, 1850, 3), "0 1000 2000");
}

TEST(ValueAxis, OfAValueThatDoesNotChangeHasItInTheMiddle) {
    EXPECT_EQ(labelsOf(-95, -95, 3), "-96 -95 -94");
    EXPECT_EQ(labelsOf(0, 0, 3), "-1 0 1");
}

TEST(ValueAxis, BetweenWholeNumbersHasNoOthers) {
    EXPECT_EQ(labelsOf(1850, 1850, 5), "1849 1850 1851");
    EXPECT_EQ(labelsOf(182, 183, 9), "182 183");
    EXPECT_EQ(labelsOf(-94.5, -94.5, 5), "-95.5 -95.0 -94.5 -94.0 -93.5");
}

TEST(ValueAxis, ContainsAnyNumbers) {
    for (const double most : {1e-9, 1e-3, 1.0, 4294967295.0, 1e14}) {
        for (int count = 0; count < 12; ++count) {
            const ValueAxis axis = valueAxis(-most / 3, most, count);
            EXPECT_LE(axis.labels.size(), static_cast<std::size_t>(std::max(count, 3)));
            EXPECT_LE(axis.least, -most / 3);
            EXPECT_GE(axis.most, most);
        }
    }
    EXPECT_LE(valueAxis(-1e300, 1e300, 5).labels.size(), 5U);
}

TEST(TimeLabels, AreRoundClockTimesWithRoom) {
    EXPECT_EQ(timesOf(minutes(5), 70), "22:14 22:15 22:16 22:17 22:18");
    EXPECT_EQ(timesOf(minutes(5), 20), "22:15");
    EXPECT_EQ(timesOf(seconds(30), 70), "22:13:20 22:13:30 22:13:40 22:13:50");
    EXPECT_EQ(timesOf(hours(1), 70), "22:20 22:30 22:40 22:50 23:00 23:10");
    EXPECT_EQ(timesOf(hours(20), 30), "00:00 06:00 12:00 18:00");
}

TEST(TimeLabels, AreRoundInLocalTime) {
    EXPECT_EQ(timesOf(minutes(5), 70, minutes(330)), "03:44 03:45 03:46 03:47 03:48");
    EXPECT_EQ(timesOf(hours(20), 30, minutes(330)), "06:00 12:00 18:00");
}

TEST(TimeLabels, AreMissingWhereThereIsNoRoom) {
    EXPECT_EQ(timesOf(minutes(5), 0), "");
    EXPECT_EQ(timesOf(seconds(0), 70), "");
    EXPECT_EQ(timesOf(hours(24 * 3000), 10), "");
}

} // namespace
} // namespace pallax
