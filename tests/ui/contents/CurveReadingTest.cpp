#include "ui/contents/CurveReading.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

constexpr Time kWindowStart{std::chrono::seconds(1700000000)};

Time second(int number) {
    return kWindowStart + std::chrono::seconds(number);
}

/// The middle of a column of a second.
Time middle(int number) {
    return second(number) + std::chrono::milliseconds(500);
}

class CurveReadingTest : public testing::Test {
protected:
    CurveReadingTest() { reading.fit(second(0), second(60), 60); }
    CurveReading reading;
};

TEST_F(CurveReadingTest, TheCursorBeginsAtTheEndAndStaysInTheWindow) {
    EXPECT_FALSE(reading.cursor());
    reading.back();
    EXPECT_EQ(reading.cursor(), middle(59));
    reading.back();
    EXPECT_EQ(reading.cursor(), middle(58));
    reading.forward();
    reading.forward();
    EXPECT_EQ(reading.cursor(), middle(59));
    reading.toFirst();
    reading.back();
    EXPECT_EQ(reading.cursor(), middle(0));
    reading.forward();
    EXPECT_EQ(reading.cursor(), middle(1));
    reading.toLast();
    EXPECT_EQ(reading.cursor(), middle(59));
    reading.leave();
    EXPECT_FALSE(reading.cursor());
    reading.forward();
    EXPECT_EQ(reading.cursor(), middle(59));
}

TEST_F(CurveReadingTest, TheCursorGoesToTheColumnOfATime) {
    reading.moveTo(second(20) + std::chrono::milliseconds(700));
    EXPECT_EQ(reading.cursor(), middle(20));
    reading.moveTo(second(-5));
    EXPECT_EQ(reading.cursor(), middle(0));
    reading.moveTo(second(70));
    EXPECT_EQ(reading.cursor(), middle(59));
}

TEST_F(CurveReadingTest, TheCursorStaysAtItsTimeWhileTheWindowMoves) {
    reading.toFirst();
    reading.forward();
    reading.fit(second(1), second(61), 60);
    EXPECT_EQ(reading.cursor(), middle(1));
    reading.fit(second(10), second(70), 60);
    EXPECT_EQ(reading.cursor(), second(10));
    reading.fit(second(10), second(10), 60);
    EXPECT_FALSE(reading.cursor());
    EXPECT_FALSE(reading.hasCurve());
}

TEST_F(CurveReadingTest, EachStepIsAColumnWhateverItsLength) {
    reading.fit(second(0), second(300), 71);
    reading.toFirst();
    for (int column = 1; column < 71; ++column) {
        reading.forward();
        const auto at = std::chrono::duration<double>(*reading.cursor() - second(0)).count();
        EXPECT_EQ(static_cast<int>(at / 300 * 71), column);
    }
}

TEST_F(CurveReadingTest, TheSpanIsFromHalfAMinuteToAllTime) {
    EXPECT_EQ(reading.span(), std::chrono::seconds(300));
    EXPECT_EQ(reading.spanWords(), "the last 5 minutes");
    for (int times = 0; times < 4; ++times) {
        reading.zoomIn();
    }
    EXPECT_EQ(reading.spanWords(), "the last 30 seconds");
    for (int times = 0; times < 9; ++times) {
        reading.zoomOut();
    }
    EXPECT_EQ(reading.spanWords(), "all time");
    EXPECT_FALSE(reading.span());
    reading.choose(4);
    EXPECT_EQ(reading.spanWords(), "the last hour");
    EXPECT_EQ(reading.chosen(), 4U);
}

TEST_F(CurveReadingTest, TheWordsAtTheCursorAreThoseOfItsColumn) {
    const std::vector<CurveEvent> events{{second(10), "one"},
                                         {second(10) + std::chrono::milliseconds(500), "two"},
                                         {second(11), "three"},
                                         {second(60), "last"}};
    EXPECT_EQ(reading.wordsAtCursor(events), "");
    reading.moveTo(second(10));
    EXPECT_EQ(reading.wordsAtCursor(events), "one; two");
    reading.forward();
    EXPECT_EQ(reading.wordsAtCursor(events), "three");
    reading.toLast();
    EXPECT_EQ(reading.wordsAtCursor(events), "last");
    reading.fit({}, {}, 0);
    EXPECT_EQ(reading.wordsAtCursor(events), "");
}

} // namespace
} // namespace pallax
