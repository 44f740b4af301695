#include "monitor/TickGrid.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

const Time kFirstStamp{seconds(1700000000)};

struct Passed {
    std::uint64_t number;
    Time time;
    friend bool operator==(const Passed&, const Passed&) = default;
};

std::optional<Passed> passedBefore(TickGrid& grid, Time packet) {
    const auto tick = grid.passedBefore(packet);
    return tick ? std::optional<Passed>({tick->number, tick->time}) : std::nullopt;
}

TEST(TickGrid, ThePacketAtATicksTimeComesAfterTheTick) {
    TickGrid grid;
    EXPECT_EQ(passedBefore(grid, kFirstStamp), std::nullopt);
    EXPECT_EQ(passedBefore(grid, kFirstStamp + milliseconds(1999)), std::nullopt);
    EXPECT_EQ(passedBefore(grid, kFirstStamp + seconds(2)), (Passed{1, kFirstStamp + seconds(2)}));
    EXPECT_EQ(passedBefore(grid, kFirstStamp + seconds(2)), std::nullopt);
    EXPECT_EQ(grid.next().number, 2U);
    EXPECT_EQ(grid.next().time, kFirstStamp + seconds(4));
}

TEST(TickGrid, OfSeveralTicksInAGapTheFirstIsTold) {
    TickGrid grid;
    (void)grid.passedBefore(kFirstStamp);
    EXPECT_EQ(passedBefore(grid, kFirstStamp + seconds(11)), (Passed{1, kFirstStamp + seconds(2)}));
    EXPECT_EQ(passedBefore(grid, kFirstStamp + seconds(12)),
              (Passed{6, kFirstStamp + seconds(12)}));
}

TEST(TickGrid, AStampALittleBeforeTheLatestMakesNoTick) {
    TickGrid grid;
    (void)grid.passedBefore(kFirstStamp);
    (void)grid.passedBefore(kFirstStamp + seconds(5));
    EXPECT_EQ(passedBefore(grid, kFirstStamp + seconds(3)), std::nullopt);
    EXPECT_EQ(grid.step(), std::nullopt);
    EXPECT_EQ(passedBefore(grid, kFirstStamp + seconds(6)), (Passed{3, kFirstStamp + seconds(6)}));
}

TEST(TickGrid, AStepBackGivesTheLastTickAndTheNextLieOnAGridFromThere) {
    TickGrid grid;
    const Time back = kFirstStamp - seconds(3600) + milliseconds(700);
    (void)grid.passedBefore(kFirstStamp);
    (void)grid.passedBefore(kFirstStamp + seconds(5));
    EXPECT_EQ(passedBefore(grid, back), (Passed{3, kFirstStamp + seconds(6)}));
    EXPECT_EQ(grid.step(),
              (StampRemark{StampRemark::Kind::StepBack, seconds(3605) - milliseconds(700)}));
    EXPECT_EQ(passedBefore(grid, back + milliseconds(1999)), std::nullopt);
    EXPECT_EQ(grid.step(), std::nullopt);
    EXPECT_EQ(passedBefore(grid, back + seconds(2)), (Passed{4, back + seconds(2)}));
    EXPECT_EQ(grid.next().number, 5U);
    EXPECT_EQ(grid.next().time, back + seconds(4));
}

TEST(TickGrid, AfterOneStampThatIsAheadTheTicksGoOn) {
    TickGrid grid;
    std::uint64_t ticks = 0;
    for (int packet = 0; packet < 240; ++packet) { // two minutes of packets
        const Time ahead =
            kFirstStamp + milliseconds(500) * packet + seconds(packet == 8 ? 3600 : 0);
        const auto tick = grid.passedBefore(ahead);
        ticks += tick ? 1 : 0;
    }
    EXPECT_EQ(ticks, 60U); // 59 without that stamp
}

TEST(TickGrid, AGapIsToldAndLeavesTheGridAsItIs) {
    TickGrid grid;
    (void)grid.passedBefore(kFirstStamp);
    EXPECT_EQ(passedBefore(grid, kFirstStamp + seconds(61)), (Passed{1, kFirstStamp + seconds(2)}));
    EXPECT_EQ(grid.step(), (StampRemark{StampRemark::Kind::Gap, seconds(61)}));
    EXPECT_EQ(passedBefore(grid, kFirstStamp + seconds(62)),
              (Passed{31, kFirstStamp + seconds(62)}));
}

TEST(TickGrid, TheWholeRangeOfTimeIsOneStep) {
    TickGrid grid;
    (void)grid.passedBefore(Time::min());
    EXPECT_EQ(grid.passedBefore(Time::max())->number, 1U);
    EXPECT_EQ(grid.next().time, Time::max());
    TickGrid late;
    (void)late.passedBefore(Time::max());
    EXPECT_EQ(late.next().number, 1U);
    EXPECT_EQ(late.next().time, Time::max());
}

TEST(TickGrid, GivesWhatSteppingGives) {
    EXPECT_TRUE(doubles::holds([] {
        const auto steps = doubles::any::integers(-6000, 9000);
        TickGrid grid;
        Time packet = kFirstStamp;
        Time latest = kFirstStamp;
        Time next = kFirstStamp + seconds(2);
        std::uint64_t passed = 0;
        (void)grid.passedBefore(kFirstStamp);
        for (const int step : steps) {
            packet += milliseconds(step);
            std::optional<Passed> expected;
            if (packet < latest - seconds(2)) {
                expected = {++passed, next};
                latest = packet;
                next = packet + seconds(2);
            }
            for (; packet >= next; next += seconds(2)) {
                ++passed;
                expected = expected ? expected : Passed{passed, next};
            }
            latest = std::max(latest, packet);
            RC_ASSERT(passedBefore(grid, packet) == expected);
            RC_ASSERT(grid.next().number == passed + 1);
            RC_ASSERT(grid.next().time == next);
        }
    }));
}

} // namespace
} // namespace pallax
