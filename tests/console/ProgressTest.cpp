#include "console/Progress.h"

#include "console/TerminalLine.h"
#include "tests/doubles/ManualClock.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::ManualClock;
using std::chrono::milliseconds;
using std::chrono::seconds;

/// A manual clock that counts its calls.
class CountedClock final : public Clock {
public:
    Time now() const override {
        ++looks;
        return clock.now();
    }
    Zone zone(Time /*time*/) const override { return {}; }

    ManualClock clock;
    mutable unsigned looks = 0;
};

TEST(ProgressPace, NothingIsDueBeforeTwoSecondsHavePassed) {
    ManualClock clock;
    ProgressPace pace(clock);
    for (int count = 0; count < 19; ++count) {
        clock.advance(milliseconds(100));
        EXPECT_FALSE(pace.isDue()) << count;
    }
    clock.advance(milliseconds(99));
    EXPECT_FALSE(pace.isDue());
    clock.advance(milliseconds(1));
    EXPECT_TRUE(pace.isDue());
}

TEST(ProgressPace, ThenItIsDueFiveTimesASecond) {
    ManualClock clock;
    ProgressPace pace(clock);
    clock.advance(seconds(2));
    int due = 0;
    for (int count = 0; count < 100; ++count) {
        due += pace.isDue() ? 1 : 0;
        clock.advance(milliseconds(20));
    }
    EXPECT_EQ(due, 10);
}

TEST(ProgressPace, QuickPiecesLookAtTheClockRarely) {
    constexpr unsigned kPieces = 64000;
    CountedClock clock;
    ProgressPace pace(clock);
    for (unsigned count = 0; count < kPieces; ++count) {
        EXPECT_FALSE(pace.isDue());
    }
    EXPECT_LE(clock.looks, kPieces / 64 + 10);
}

TEST(ProgressPace, SlowPiecesAfterQuickOnesAreEachCheckedAgain) {
    CountedClock clock;
    ProgressPace pace(clock);
    for (unsigned count = 0; count < 1000; ++count) {
        (void)pace.isDue();
    }
    constexpr unsigned kUnseen = 64;
    for (unsigned count = 0; count < kUnseen; ++count) {
        clock.clock.advance(seconds(1));
        (void)pace.isDue();
    }
    clock.clock.advance(seconds(1));
    EXPECT_TRUE(pace.isDue());
    clock.clock.advance(seconds(1));
    EXPECT_TRUE(pace.isDue());
}

TEST(ProgressBar, ItIsAsLongAsTheShare) {
    EXPECT_EQ(progressBar(0), "[                              ]   0 %");
    EXPECT_EQ(progressBar(0.337), "[##########                    ]  33 %");
    EXPECT_EQ(progressBar(0.999), "[############################# ]  99 %");
    EXPECT_EQ(progressBar(1), "[##############################] 100 %");
    EXPECT_EQ(progressBar(1.5), progressBar(1)) << "the file has grown";
    EXPECT_EQ(progressBar(-1), progressBar(0));
}

TEST(ProgressBar, PacketsAreCounted) {
    EXPECT_EQ(packetCount(0), "0 packets");
    EXPECT_EQ(packetCount(1), "1 packet");
    EXPECT_EQ(packetCount(123456789012), "123456789012 packets");
}

class TerminalLineTest : public testing::Test {
protected:
    TerminalLine line(std::size_t columns) {
        return {columns, [this](std::string_view bytes) { written += bytes; }};
    }

    std::string written;
};

TEST_F(TerminalLineTest, ATextTakesThePlaceOfTheOneBefore) {
    TerminalLine shown = line(80);
    shown.show("1000 packets");
    shown.show("7 packets");
    EXPECT_EQ(written, "\r1000 packets\r7 packets   ");
}

TEST_F(TerminalLineTest, WipedNothingStays) {
    TerminalLine shown = line(80);
    shown.wipe();
    EXPECT_EQ(written, "") << "nothing was shown before";
    shown.show("abc");
    shown.wipe();
    EXPECT_EQ(written, "\rabc\r   \r");
    shown.wipe();
    EXPECT_EQ(written, "\rabc\r   \r");
}

TEST_F(TerminalLineTest, LeftItStaysAboveWhatFollows) {
    TerminalLine shown = line(80);
    shown.leave();
    shown.show("abc");
    shown.leave();
    shown.wipe();
    EXPECT_EQ(written, "\rabc\n");
}

TEST_F(TerminalLineTest, WhatDoesNotFitIsLeftOut) {
    TerminalLine shown = line(4);
    shown.show("abcdef");
    EXPECT_EQ(written, "\rabc");
    TerminalLine narrow = line(1);
    narrow.show("abc");
    EXPECT_EQ(written, "\rabc\r");
}

TEST_F(TerminalLineTest, WithoutATerminalNothingIsWritten) {
    TerminalLine none = line(0);
    EXPECT_FALSE(none.isPossible());
    none.show("abc");
    none.wipe();
    none.leave();
    EXPECT_EQ(written, "");
}

} // namespace
} // namespace pallax
