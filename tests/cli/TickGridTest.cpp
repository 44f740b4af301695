#include "cli/TickGrid.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

namespace pallax {
namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

const Time kStart{seconds(1700000000)};

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
    EXPECT_EQ(passedBefore(grid, kStart), std::nullopt);
    EXPECT_EQ(passedBefore(grid, kStart + milliseconds(1999)), std::nullopt);
    EXPECT_EQ(passedBefore(grid, kStart + seconds(2)), (Passed{1, kStart + seconds(2)}));
    EXPECT_EQ(passedBefore(grid, kStart + seconds(2)), std::nullopt);
    EXPECT_EQ(grid.next().number, 2U);
    EXPECT_EQ(grid.next().time, kStart + seconds(4));
}

TEST(TickGrid, OfSeveralTicksInAGapTheFirstIsTold) {
    TickGrid grid;
    (void)grid.passedBefore(kStart);
    EXPECT_EQ(passedBefore(grid, kStart + seconds(11)), (Passed{1, kStart + seconds(2)}));
    EXPECT_EQ(passedBefore(grid, kStart + seconds(12)), (Passed{6, kStart + seconds(12)}));
}

TEST(TickGrid, TimeThatGoesBackwardsMakesNoTick) {
    TickGrid grid;
    (void)grid.passedBefore(kStart);
    (void)grid.passedBefore(kStart + seconds(5));
    EXPECT_EQ(passedBefore(grid, kStart - seconds(100)), std::nullopt);
    EXPECT_EQ(passedBefore(grid, kStart + seconds(3)), std::nullopt);
    EXPECT_EQ(passedBefore(grid, kStart + seconds(6)), (Passed{3, kStart + seconds(6)}));
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
    EXPECT_TRUE(rc::check([](const std::vector<std::int16_t>& steps) {
        TickGrid grid;
        Time packet = kStart;
        std::uint64_t passed = 0;
        for (const std::int16_t& step : steps) {
            packet += milliseconds(step);
            if (&step == steps.data()) {
                packet = kStart;
            }
            const std::uint64_t before = passed;
            while (packet >= kStart + seconds(2) * static_cast<std::int64_t>(passed + 1)) {
                ++passed;
            }
            const auto tick = grid.passedBefore(packet);
            RC_ASSERT(tick.has_value() == (passed > before));
            if (tick) { // RC_ASSERT looks at both sides of a ||
                RC_ASSERT(tick->number == before + 1);
            }
        }
    }));
}

} // namespace
} // namespace pallax
