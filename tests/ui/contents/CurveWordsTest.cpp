#include "ui/contents/CurveWords.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using std::chrono::hours;
using std::chrono::seconds;

constexpr Time kCurveStart{seconds(1700000000)}; // 22:13:20

class CurveWordsTest : public testing::Test {
protected:
    CurveWordsTest() {
        level.name = "level";
        level.unit = "dBm";
        code.name = "code";
        curve.points = {{kCurveStart, -94, -101.5, -90, -92},
                        {kCurveStart + seconds(30), -92, -92, -82.25, -85.125}};
        reading.fit(kCurveStart, kCurveStart + seconds(60), 60);
    }
    std::string words(const FieldInfo& field) {
        return curveWords(curve, field, reading, {{kCurveStart + seconds(10), "cell change"}},
                          hours(1));
    }

    FieldInfo level;
    FieldInfo code;
    Curve curve;
    CurveReading reading;
};

TEST_F(CurveWordsTest, AreTheExtentAndTheMeanOfTheTime) {
    EXPECT_EQ(words(level), "min -101.5  mean -91.44  max -82.25 dBm  of the last 5 minutes");
    curve.isReduced = true;
    EXPECT_EQ(words(level), "min -101.5  mean about -91.44  max -82.25 dBm  of the last 5 minutes");
    EXPECT_EQ(words(code), "min -101.5  max -82.25  of the last 5 minutes")
        << "the mean of codes says nothing";
}

TEST_F(CurveWordsTest, AreWhatTheCursorIsOn) {
    reading.moveTo(kCurveStart + seconds(10));
    EXPECT_EQ(words(level), "23:13:30  -92 dBm  cell change");
    reading.moveTo(kCurveStart + seconds(40));
    EXPECT_EQ(words(code), "23:14:00  -85.125");
    curve.points.erase(curve.points.begin());
    reading.toFirst();
    EXPECT_EQ(words(level), "23:13:20  no value");
}

TEST_F(CurveWordsTest, SayThatThereIsNoValue) {
    curve.points.clear();
    EXPECT_EQ(words(level), "no value in the last 5 minutes");
    EXPECT_FALSE(statisticsOf(curve, level));
}

} // namespace
} // namespace pallax
