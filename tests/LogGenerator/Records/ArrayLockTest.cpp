#include "LogGenerator/Records/ArrayLock.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <future>
#include <thread>

namespace pallax {
namespace {

/// How long a thread gets to take a lock that it must not get.
constexpr std::chrono::milliseconds kPatience{100};

/// A thread that takes the lock, says so, and gives it back.
std::future<void> visit(std::thread& visitor) {
    auto entered = std::make_shared<std::promise<void>>();
    visitor = std::thread([entered] {
        ArrayLock::lockArray();
        entered->set_value();
        ArrayLock::unlockArray();
    });
    return entered->get_future();
}

TEST(ArrayLock, APairAddsOneToTheDepthAndTakesItAway) {
    ASSERT_EQ(ArrayLock::depth(), 0);
    ArrayLock::lockArray();
    EXPECT_EQ(ArrayLock::depth(), 1);
    ArrayLock::unlockArray();
    EXPECT_EQ(ArrayLock::depth(), 0);
}

TEST(ArrayLock, AnotherThreadWaitsUntilThePairIsClosed) {
    ArrayLock::lockArray();
    std::thread visitor;
    auto entered = visit(visitor);
    EXPECT_EQ(entered.wait_for(kPatience), std::future_status::timeout);
    ArrayLock::unlockArray();
    entered.wait();
    visitor.join();
    EXPECT_EQ(ArrayLock::depth(), 0);
}

// The tests below leave the lock held, each in a process of its own that ends with a verdict:
// 0 when another thread cannot take the lock, 1 when it can.

[[noreturn]] void endWithVerdict() {
    std::thread visitor;
    auto entered = visit(visitor);
    const bool excluded = entered.wait_for(kPatience) == std::future_status::timeout;
    std::_Exit(excluded ? 0 : 1);
}

TEST(ArrayLockDeathTest, ThreadThatNestsTwicePairsKeepsHoldingTheLockOneLevelDeep) {
    const auto nestTwice = [] {
        ArrayLock::lockArray();
        ArrayLock::lockArray();
        ArrayLock::unlockArray();
        ArrayLock::unlockArray();
        if (ArrayLock::depth() != 0) {
            std::_Exit(2);
        }
        endWithVerdict();
    };
    EXPECT_EXIT(nestTwice(), testing::ExitedWithCode(0), "");
}

TEST(ArrayLockDeathTest, WithoutNestingTheSameVerdictIsThatTheLockIsFree) {
    const auto twoPairs = [] {
        ArrayLock::lockArray();
        ArrayLock::unlockArray();
        ArrayLock::lockArray();
        ArrayLock::unlockArray();
        endWithVerdict();
    };
    EXPECT_EXIT(twoPairs(), testing::ExitedWithCode(1), "");
}

TEST(ArrayLockDeathTest, TheDepthWrapsAroundAt8Bits) {
    const auto wrap = [] {
        constexpr int kDepths = 256;
        for (int count = 0; count < kDepths; ++count) {
            ArrayLock::lockArray();
        }
        if (ArrayLock::depth() != 0) {
            std::_Exit(2);
        }
        ArrayLock::unlockArray();
        std::_Exit(ArrayLock::depth() == kDepths - 1 ? 0 : 1);
    };
    EXPECT_EXIT(wrap(), testing::ExitedWithCode(0), "");
}

} // namespace
} // namespace pallax
