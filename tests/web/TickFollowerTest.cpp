#include "web/TickFollower.h"

#include "decoding/DisplayJson.h"
#include "tests/timeline/TimelineFixture.h"
#include "timeline/Instants.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax {
namespace {

using namespace std::chrono_literals;

struct Told {
    std::uint64_t number;
    Time time;
    std::uint64_t packet;
    std::size_t values; ///< fields with a value

    friend bool operator==(const Told&, const Told&) = default;
};

class TickFollowerTest : public testing::Test {
protected:
    TickFollower::Tell tell() {
        return [this](const ShownTick& tick, const CurrentValues& values) {
            std::size_t count = 0;
            for (FieldIndex field = 0; field < values.fieldCount(); ++field) {
                count += values.value(field) != nullptr ? 1U : 0U;
            }
            told.push_back({tick.tick.number, tick.tick.time, tick.packet, count});
        };
    }
    /// What a walk over all packets says, by the packets' times alone.
    static std::vector<Told> expected(Timeline& timeline, const MemoryJournal& journal) {
        TickGrid grid;
        std::vector<Told> ticks;
        std::uint64_t shown = 0;
        const auto show = [&](const TickGrid::Tick& tick, std::uint64_t packet) {
            if (packet > shown) {
                const CurrentValues values = timeline.valuesAt(packet);
                std::size_t count = 0;
                for (FieldIndex field = 0; field < values.fieldCount(); ++field) {
                    count += values.value(field) != nullptr ? 1U : 0U;
                }
                ticks.push_back({tick.number, tick.time, packet, count});
                shown = packet;
            }
        };
        for (std::uint64_t packet = 1; packet <= journal.size(); ++packet) {
            if (const auto passed = grid.passedBefore(journal.packet(packet).time)) {
                show(*passed, packet - 1);
            }
        }
        show(grid.next(), journal.size());
        return ticks;
    }

    std::vector<Told> told;
};

const auto kAlways = [] { return true; };

TEST_F(TickFollowerTest, TellsEachTickWithItsValues) {
    TimelineFixture recorded("lte");
    recorded.drive(7, 30s);
    const auto timeline = recorded.indexed();
    TickFollower follower(*timeline);
    EXPECT_TRUE(follower.follow(tell(), kAlways));
    auto all = expected(*timeline, recorded.journal);
    ASSERT_EQ(all.size(), 15U);
    const Told last = all.back();
    all.pop_back();
    EXPECT_EQ(told, all) << "packets may still come before the last tick";
    follower.settle(tell());
    EXPECT_EQ(told.back(), last);
    follower.settle(tell());
    EXPECT_EQ(told.size(), 15U) << "once";
}

TEST_F(TickFollowerTest, TellsTheSameWhileTheTimelineGrows) {
    TimelineFixture whole("lte");
    whole.drive(7, 20s);
    const auto all = whole.indexed();
    TimelineFixture growing("lte");
    Timeline timeline(growing.journal, growing.source());
    TickFollower follower(timeline);
    EXPECT_TRUE(follower.follow(tell(), kAlways)) << "nothing yet";
    follower.settle(tell());
    EXPECT_EQ(told.size(), 0U);
    for (std::uint64_t packet = 1; packet <= whole.journal.size(); ++packet) {
        const JournalPacket each = whole.journal.packet(packet);
        growing.journal.add(each.time, ByteBuffer(each.data.begin(), each.data.end()));
        ASSERT_TRUE(timeline.index());
        int looks = 0;
        while (!follower.follow(tell(), [&looks] { return ++looks % 2 == 0; })) {
        }
    }
    follower.settle(tell());
    EXPECT_EQ(told, expected(*all, whole.journal));
}

TEST_F(TickFollowerTest, APacketAfterATickWasSettledIsShownByTheNextOne) {
    TimelineFixture recorded("lte");
    Timeline timeline(recorded.journal, recorded.source());
    TickFollower follower(timeline);
    const auto add = [&](std::chrono::milliseconds time) {
        Simulation simulation({&recorded.technology, 1, 40, 1s});
        const auto packet = simulation.next();
        recorded.journal.add(Simulation::kStart + time,
                             ByteBuffer(packet->data.begin(), packet->data.end()));
        ASSERT_TRUE(timeline.index());
        ASSERT_TRUE(follower.follow(tell(), kAlways));
    };
    add(0ms);
    add(100ms);
    follower.settle(tell());
    ASSERT_EQ(told.size(), 1U);
    EXPECT_EQ(told[0].number, 1U);
    EXPECT_EQ(told[0].packet, 2U);
    add(1900ms);
    add(2100ms); // the first tick again
    EXPECT_EQ(told.size(), 1U);
    add(4100ms);
    ASSERT_EQ(told.size(), 2U);
    EXPECT_EQ(told[1].number, 2U);
    EXPECT_EQ(told[1].packet, 4U);
}

TEST_F(TickFollowerTest, BeginsWhereTheJournalDoes) {
    TimelineFixture recorded("gsm");
    recorded.drive(3, 30s);
    recorded.journal.dropBefore(500);
    const auto timeline = recorded.indexed();
    TickFollower follower(*timeline);
    EXPECT_TRUE(follower.follow(tell(), kAlways));
    follower.settle(tell());
    ASSERT_FALSE(told.empty());
    EXPECT_EQ(told.back().packet, recorded.journal.size());
}

} // namespace
} // namespace pallax
