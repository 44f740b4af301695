#include "watching/HeldCondition.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <vector>

namespace pallax {
namespace {

using Change = HeldCondition::Change;
using std::chrono::seconds;

constexpr Time kStart{seconds(1700000000)};

TEST(HeldCondition, BecomesTrueAtOnceAndEndsWhenItDoesNotHold) {
    HeldCondition condition;
    EXPECT_EQ(condition.at(kStart, false), Change::None);
    EXPECT_EQ(condition.at(kStart + seconds(2), true), Change::BecameTrue);
    EXPECT_EQ(condition.held(), seconds(0));
    EXPECT_EQ(condition.at(kStart + seconds(4), true), Change::None);
    EXPECT_EQ(condition.held(), seconds(2));
    EXPECT_EQ(condition.at(kStart + seconds(6), false), Change::Ended);
    EXPECT_EQ(condition.held(), seconds(4));
    EXPECT_EQ(condition.at(kStart + seconds(8), false), Change::None);
    EXPECT_EQ(condition.held(), seconds(4)) << "it held no longer";
    EXPECT_EQ(condition.at(kStart + seconds(10), true), Change::BecameTrue);
    EXPECT_EQ(condition.held(), seconds(0));
}

TEST(HeldCondition, BecomesTrueAtTheFirstTick) {
    EXPECT_EQ(HeldCondition().at(kStart, true), Change::BecameTrue);
}

TEST(HeldCondition, BecomesTrueWhenItHasHeldForSoLong) {
    HeldCondition condition(seconds(4));
    EXPECT_EQ(condition.at(kStart, true), Change::None);
    EXPECT_EQ(condition.at(kStart + seconds(2), true), Change::None);
    EXPECT_EQ(condition.at(kStart + seconds(4), true), Change::BecameTrue);
    EXPECT_EQ(condition.at(kStart + seconds(6), true), Change::None);
    EXPECT_EQ(condition.at(kStart + seconds(8), false), Change::Ended);
    EXPECT_EQ(condition.held(), seconds(8)) << "from the first tick at which it held";
}

TEST(HeldCondition, AnInterruptionStartsTheTimeAgain) {
    HeldCondition condition(seconds(4));
    EXPECT_EQ(condition.at(kStart, true), Change::None);
    EXPECT_EQ(condition.at(kStart + seconds(2), false), Change::None) << "it was never true";
    EXPECT_EQ(condition.at(kStart + seconds(4), true), Change::None);
    EXPECT_EQ(condition.at(kStart + seconds(6), true), Change::None);
    EXPECT_EQ(condition.at(kStart + seconds(8), true), Change::BecameTrue);
}

TEST(HeldCondition, AClockThatIsSetBackCountsAsNoTime) {
    HeldCondition condition(seconds(4));
    EXPECT_EQ(condition.at(kStart, true), Change::None);
    EXPECT_EQ(condition.at(kStart + seconds(2), true), Change::None);
    EXPECT_EQ(condition.at(kStart - seconds(100), true), Change::None);
    EXPECT_EQ(condition.held(), seconds(2));
    EXPECT_EQ(condition.at(kStart - seconds(98), true), Change::BecameTrue);
}

TEST(HeldCondition, ChangesAlternateAndTheTimeIsThatSinceItBeganToHold) {
    EXPECT_TRUE(doubles::holds([] {
        const seconds needed(doubles::any::between(0, 9));
        HeldCondition condition(needed);
        Time tick = kStart;
        std::optional<Time> since;
        bool isTrue = false;
        for (int count = doubles::any::between(0, 30); count > 0; --count) {
            tick += seconds(doubles::any::between(1, 5));
            const bool holds = doubles::any::between(0, 3) > 0;
            const Change change = condition.at(tick, holds);
            since = holds ? since.value_or(tick) : std::optional<Time>();
            const bool shouldBe = since && tick - *since >= needed;
            RC_ASSERT(change == (shouldBe == isTrue ? Change::None
                                 : shouldBe         ? Change::BecameTrue
                                                    : Change::Ended));
            isTrue = shouldBe;
            if (since) {
                RC_ASSERT(condition.held() == tick - *since);
            }
        }
    }));
}

} // namespace
} // namespace pallax
