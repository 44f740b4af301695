#include "host/SourceClock.h"

#include "tests/doubles/ManualClock.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

#include <limits>

namespace pallax {
namespace {

using namespace std::chrono_literals;

class SourceClockTest : public testing::Test {
protected:
    static Time at(std::chrono::nanoseconds sinceStart) {
        return Time(std::chrono::seconds(1'000'000)) + sinceStart;
    }
    /// Advances like a port: step by step until the time is reached.
    void reach(std::chrono::nanoseconds sinceStart) {
        while (_clock.advance(at(sinceStart))) {
        }
    }
    std::unique_ptr<RepeatingTimer> tick(std::chrono::nanoseconds interval) {
        return _clock.scheduleRepeating(interval,
                                        [this] { _ticks.push_back(_clock.now() - at(0s)); });
    }

    doubles::ManualClock _wall;
    doubles::SteppedQueue _queue;
    SourceClock _clock{_wall, _queue,
                       [this] { return std::chrono::steady_clock::time_point(_queue.now()); }};
    std::vector<std::chrono::nanoseconds> _ticks; // the clock's times of the ticks, since at(0)
};

using Ticks = std::vector<std::chrono::nanoseconds>;

TEST_F(SourceClockTest, IsTheWallClockUntilASourceTimeIsHeard) {
    EXPECT_EQ(_clock.now(), doubles::ManualClock::kStart);
    reach(0s);
    EXPECT_EQ(_clock.now(), at(0s));
    reach(500ms);
    EXPECT_EQ(_clock.now(), at(500ms));
}

TEST_F(SourceClockTest, TheZoneIsTheWallClocks) {
    _wall.setZone({1h, true});
    EXPECT_EQ(_clock.zone(at(0s)).offset, 1h);
    EXPECT_TRUE(_clock.zone(at(0s)).daylightSaving);
}

TEST_F(SourceClockTest, TicksLieOnTheGridOfTheFirstSourceTime) {
    const auto timer = tick(2s);
    for (const auto time : {0ms, 1999ms, 2000ms, 3500ms, 4001ms, 6000ms}) {
        reach(time);
    }
    EXPECT_EQ(_ticks, (Ticks{2s, 4s, 6s}));
    EXPECT_EQ(_clock.now(), at(6s));
}

TEST_F(SourceClockTest, AGapGivesOneTickAndTheNextLiesOnTheGridAfterIt) {
    const auto timer = tick(2s);
    reach(0s);
    reach(std::chrono::hours(24 * 365) + 1s);
    EXPECT_EQ(_ticks, (Ticks{2s}));
    reach(std::chrono::hours(24 * 365) + 2s);
    EXPECT_EQ(_ticks, (Ticks{2s, std::chrono::hours(24 * 365) + 2s}));
}

TEST_F(SourceClockTest, AtATimeOfTheGridTheNextTickIsAWholeIntervalLater) {
    const auto timer = tick(2s);
    reach(0s);
    reach(10s);
    reach(11999ms);
    EXPECT_EQ(_ticks, (Ticks{2s}));
    reach(12s);
    EXPECT_EQ(_ticks, (Ticks{2s, 12s}));
}

TEST_F(SourceClockTest, SeveralTimersTickInTheOrderOfTheirTimes) {
    std::vector<int> order;
    const auto slow = _clock.scheduleRepeating(3s, [&] { order.push_back(3); });
    const auto quick = _clock.scheduleRepeating(2s, [&] { order.push_back(2); });
    reach(0s);
    reach(3500ms);
    EXPECT_EQ(order, (std::vector<int>{2, 3}));
}

TEST_F(SourceClockTest, EachTickIsAStepOfItsOwn) {
    const auto timer = tick(2s);
    reach(0s);
    EXPECT_TRUE(_clock.advance(at(2500ms)));
    EXPECT_EQ(_clock.now(), at(2s));
    EXPECT_FALSE(_clock.advance(at(2500ms)));
    EXPECT_EQ(_clock.now(), at(2500ms));
}

TEST_F(SourceClockTest, ATimerScheduledLaterJoinsTheGrid) {
    reach(0s);
    reach(3s);
    const auto timer = tick(2s);
    reach(4s);
    EXPECT_EQ(_ticks, (Ticks{4s}));
}

TEST_F(SourceClockTest, AStampThatStepsBackMovesNothing) {
    const auto timer = tick(2s);
    reach(0s);
    reach(1500ms);
    reach(1s);
    EXPECT_EQ(_clock.now(), at(1500ms));
    EXPECT_EQ(_ticks, Ticks{});
}

TEST_F(SourceClockTest, AnInvalidatedTimerTicksNoMore) {
    const auto timer = tick(2s);
    auto other = tick(2s);
    reach(0s);
    timer->invalidate();
    other.reset();
    reach(10s);
    _queue.advance(10s);
    EXPECT_EQ(_ticks, Ticks{});
}

TEST_F(SourceClockTest, ATimerMayEndItselfInItsAction) {
    int ticks = 0;
    std::unique_ptr<RepeatingTimer> timer;
    timer = _clock.scheduleRepeating(2s, [&] {
        ++ticks;
        timer.reset();
    });
    reach(0s);
    reach(20s);
    EXPECT_EQ(ticks, 1);
}

TEST_F(SourceClockTest, ANewConnectionBeginsAGridOfItsOwn) {
    const auto timer = tick(2s);
    reach(100s);
    _clock.sourceBegan(false);
    reach(1s);
    EXPECT_EQ(_clock.now(), at(1s));
    reach(3s);
    EXPECT_EQ(_ticks, (Ticks{3s}));
}

TEST_F(SourceClockTest, WithoutASourceTheTimersRunByTheWallClock) {
    const auto timer = tick(2s);
    _queue.advance(6s);
    EXPECT_EQ(_ticks.size(), 3U);
}

TEST_F(SourceClockTest, WhileTheSourceIsHeardTheWallClockTicksNothing) {
    const auto timer = tick(2s);
    for (int step = 0; step < 20; ++step) {
        reach(1ms * step); // a slow source
        _queue.advance(500ms);
    }
    EXPECT_EQ(_ticks, Ticks{});
}

TEST_F(SourceClockTest, AfterTwoSecondsOfSilenceTheWallClockTakesOver) {
    const auto timer = tick(2s); // by the wall clock at 2 s, 4 s, 6 s
    _queue.advance(1s);
    reach(0s);
    _queue.advance(1999ms);
    EXPECT_EQ(_ticks.size(), 0U);
    _queue.advance(1001ms); // 4 s: silent for 3 s
    EXPECT_EQ(_ticks, (Ticks{3s}));
    reach(1s);
    _queue.advance(1900ms);
    EXPECT_EQ(_ticks.size(), 1U);
}

TEST_F(SourceClockTest, InAPauseOfTheSourceTheClockRunsOnAndAfterItsEndItStands) {
    reach(10s);
    _queue.advance(2s);
    EXPECT_EQ(_clock.now(), at(10s));
    _queue.advance(3s);
    EXPECT_EQ(_clock.now(), at(15s));
    reach(11s);
    EXPECT_EQ(_clock.now(), at(11s));
    _clock.sourceEnded();
    _queue.advance(1h);
    EXPECT_EQ(_clock.now(), at(11s));
    _clock.sourceBegan(false);
    reach(0s);
    _queue.advance(5s);
    EXPECT_EQ(_clock.now(), at(5s));
}

TEST_F(SourceClockTest, AStepBackGivesTheLastTickAndAGridThatBeginsThere) {
    const auto timer = tick(2s);
    reach(0s);
    reach(5s);
    reach(-3600s);
    EXPECT_EQ(_ticks, (Ticks{2s, 6s}));
    EXPECT_EQ(_clock.now(), at(-3600s));
    reach(-3598001ms);
    EXPECT_EQ(_ticks, (Ticks{2s, 6s}));
    reach(-3598s);
    EXPECT_EQ(_ticks, (Ticks{2s, 6s, -3598s}));
}

TEST_F(SourceClockTest, AtAStepBackEachTimerTicksOnceInTheOrderOfTheirTimes) {
    std::vector<int> order;
    const auto slow = _clock.scheduleRepeating(3s, [&] { order.push_back(3); });
    const auto quick = _clock.scheduleRepeating(2s, [&] { order.push_back(2); });
    reach(10s);
    EXPECT_TRUE(_clock.advance(at(0s)));
    EXPECT_EQ(_clock.now(), at(12s));
    EXPECT_TRUE(_clock.advance(at(0s)));
    EXPECT_EQ(_clock.now(), at(13s));
    EXPECT_FALSE(_clock.advance(at(0s)));
    EXPECT_EQ(order, (std::vector<int>{2, 3}));
}

TEST_F(SourceClockTest, ATimerThatIsScheduledByALastTickBelongsToTheNextStretch) {
    int ticks = 0;
    std::unique_ptr<RepeatingTimer> other;
    const auto timer = _clock.scheduleRepeating(2s, [&] {
        ++ticks;
        other = tick(2s);
    });
    reach(10s);
    reach(0s);
    EXPECT_EQ(ticks, 1);
    EXPECT_EQ(_ticks, Ticks{});
    reach(2s);
    EXPECT_EQ(ticks, 2);
}

TEST_F(SourceClockTest, ALiveSourcesStampsMoveNeitherClockNorTimers) {
    const auto timer = tick(2s);
    _clock.sourceBegan(true);
    for (const auto stamp : {0s, 3600s, -3600s, -3600s, 7200s, 0s}) {
        reach(stamp);
        EXPECT_EQ(_clock.now(), _wall.now());
        EXPECT_EQ(_clock.stamp(), at(stamp));
    }
    EXPECT_EQ(_ticks, Ticks{});
    for (int step = 0; step < 20; ++step) { // ten seconds
        _wall.advance(500ms);
        _queue.advance(500ms);
        reach(-3600s); // a clock that was set back and stopped
    }
    EXPECT_EQ(_ticks.size(), 5U);
    _wall.advance(5s); // a pause
    EXPECT_EQ(_clock.now(), doubles::ManualClock::kStart + 15s);
}

TEST_F(SourceClockTest, TheEndOfALiveSourceIsATick) {
    const auto timer = tick(2s);
    const auto gone = tick(2s);
    gone->invalidate();
    _clock.sourceBegan(true);
    reach(0s);
    _clock.sourceEnded();
    EXPECT_EQ(_ticks.size(), 1U);
}

TEST_F(SourceClockTest, AfterALiveSourceAPlayedOneTellsTheTimeAgain) {
    const auto timer = tick(2s);
    _clock.sourceBegan(true);
    reach(100s);
    _clock.sourceBegan(false);
    reach(0s);
    reach(3s);
    EXPECT_EQ(_clock.now(), at(3s));
    EXPECT_EQ(_ticks, (Ticks{2s}));
}

TEST_F(SourceClockTest, AStampIsToldAsItIs) {
    EXPECT_EQ(_clock.stamp(), doubles::ManualClock::kStart);
    reach(10s);
    reach(9s);
    EXPECT_EQ(_clock.now(), at(10s));
    EXPECT_EQ(_clock.stamp(), at(9s));
}

TEST_F(SourceClockTest, RemarksOnStampsAreHandedOn) {
    const StampRemark gap{StampRemark::Kind::Gap, 61s};
    _clock.stampRemark(1, gap); // nobody listens
    std::vector<std::pair<std::uint32_t, StampRemark>> told;
    _clock.onStampRemark([&](std::uint32_t packet, const StampRemark& remark) {
        told.emplace_back(packet, remark);
    });
    _clock.stampRemark(18, gap);
    EXPECT_EQ(told, (std::vector<std::pair<std::uint32_t, StampRemark>>{{18, gap}}));
}

TEST_F(SourceClockTest, TellsTheEndOfTheSource) {
    int ends = 0;
    _clock.sourceEnded();
    _clock.onEnd([&] { ++ends; });
    _clock.sourceEnded();
    EXPECT_EQ(ends, 1);
}

TEST_F(SourceClockTest, TimesAtTheEdgeOfTheRangeOverflowNothing) {
    const auto timer = tick(2s);
    const auto edge = [](std::int64_t count) { return Time(std::chrono::nanoseconds(count)); };
    for (const std::int64_t count : {std::numeric_limits<std::int64_t>::min(), std::int64_t{0},
                                     std::numeric_limits<std::int64_t>::max()}) {
        while (_clock.advance(edge(count))) {
        }
    }
    EXPECT_EQ(_clock.now(), kLatestTime + 1min);
    EXPECT_EQ(_clock.stamp(), kLatestTime);
    EXPECT_EQ(_ticks.size(), 1U);
}

TEST_F(SourceClockTest, TheLatestPacketThatThereCanBeIsFollowedByATick) {
    const auto timer = tick(2s);
    for (const Time time : {kLatestTime, kLatestTime, kLatestTime + 2s}) {
        while (_clock.advance(time)) {
        }
    }
    EXPECT_EQ(_ticks.size(), 1U);
}

TEST(SourceClockProperty, TheSamePacketsGiveTheSameTicksWithAnyClockFramesBetween) {
    // A tick "sees" the packets before it; a tick without new packets shows nothing.
    const auto seenBy = [](const std::vector<std::int64_t>& packets, bool withClockFrames) {
        doubles::ManualClock wall;
        doubles::SteppedQueue queue;
        SourceClock clock(wall, queue, [] { return std::chrono::steady_clock::time_point(); });
        std::vector<std::pair<std::int64_t, int>> seen; // tick time, packets so far
        int count = 0;
        int shown = 0;
        const auto timer = clock.scheduleRepeating(2s, [&] {
            if (count > shown) {
                shown = count;
                seen.emplace_back(clock.now().time_since_epoch().count(), count);
            }
        });
        const auto reach = [&](std::int64_t time) {
            while (clock.advance(Time(std::chrono::nanoseconds(time)))) {
            }
        };
        std::int64_t now = 0;
        for (const std::int64_t gap : packets) {
            for (int step = 1; withClockFrames && count > 0 && step < 5; ++step) {
                reach(now + gap * step / 5);
            }
            now += gap;
            reach(now);
            ++count;
        }
        reach(now + 2'000'000'000);
        return seen;
    };
    EXPECT_TRUE(doubles::holds([&] {
        std::vector<std::int64_t> gaps(doubles::any::index(100));
        std::generate(gaps.begin(), gaps.end(),
                      [] { return doubles::any::longBetween(0, 9'000'000'000); });
        RC_ASSERT(seenBy(gaps, false) == seenBy(gaps, true));
    }));
}

} // namespace
} // namespace pallax
