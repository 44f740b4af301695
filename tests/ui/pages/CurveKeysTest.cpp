#include "ui/pages/CurveKeys.h"

#include <gtest/gtest.h>

namespace pallax::terminal {
namespace {

constexpr Time kWindowStart{std::chrono::seconds(1700000000)};

/// The middle of a column of a second.
Time middle(int number) {
    return kWindowStart + std::chrono::seconds(number) + std::chrono::milliseconds(500);
}

class CurveKeysTest : public testing::Test {
protected:
    CurveKeysTest() { reading.fit(kWindowStart, kWindowStart + std::chrono::seconds(60), 60); }
    bool press(const KeyEvent& event) { return handleCurveKey(reading, event); }

    CurveReading reading;
};

TEST_F(CurveKeysTest, ArrowsAndTheirLettersMoveTheCursor) {
    EXPECT_TRUE(press({.key = Key::Left}));
    EXPECT_EQ(reading.cursor(), middle(59));
    EXPECT_TRUE(press(typed(U'h')));
    EXPECT_EQ(reading.cursor(), middle(58));
    EXPECT_TRUE(press({.key = Key::Right}));
    EXPECT_EQ(reading.cursor(), middle(59));
    EXPECT_TRUE(press({.key = Key::Home}));
    EXPECT_EQ(reading.cursor(), middle(0));
    EXPECT_TRUE(press(typed(U'l')));
    EXPECT_EQ(reading.cursor(), middle(1));
    EXPECT_TRUE(press({.key = Key::End}));
    EXPECT_EQ(reading.cursor(), middle(59));
}

TEST_F(CurveKeysTest, PlusAndMinusZoom) {
    EXPECT_TRUE(press(typed(U'+')));
    EXPECT_EQ(reading.spanWords(), "the last minute");
    EXPECT_TRUE(press(typed(U'=')));
    EXPECT_EQ(reading.spanWords(), "the last 30 seconds");
    EXPECT_TRUE(press(typed(U'-')));
    EXPECT_EQ(reading.spanWords(), "the last minute");
}

TEST_F(CurveKeysTest, WithoutACurveNoKeyIsTaken) {
    reading.fit({}, {}, 0);
    for (const KeyEvent& event : {KeyEvent{.key = Key::Left}, typed(U'+'), typed(U'-'), typed(U'h'),
                                  KeyEvent{.key = Key::End}}) {
        EXPECT_FALSE(press(event));
    }
}

TEST_F(CurveKeysTest, OtherKeysAreNotTaken) {
    EXPECT_FALSE(press({.key = Key::Enter}));
    EXPECT_FALSE(press(typed(U'x')));
}

} // namespace
} // namespace pallax::terminal
