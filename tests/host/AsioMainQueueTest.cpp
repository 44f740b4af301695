#include "host/AsioMainQueue.h"

#include "host/Descriptor.h"

#include <gtest/gtest.h>

#include <array>
#include <csignal>
#include <optional>
#include <stdexcept>
#include <thread>

namespace pallax {
namespace {

using namespace std::chrono_literals;

TEST(AsioMainQueue, BlocksRunInTheOrderOfTheirPosting) {
    AsioMainQueue queue;
    std::vector<int> order;
    queue.async([&] {
        order.push_back(1);
        queue.async([&] { order.push_back(3); });
    });
    queue.async([&] { order.push_back(2); });
    queue.runReady();
    EXPECT_EQ(order, (std::vector<int>{1, 2, 3}));
}

TEST(AsioMainQueue, RunWaitsUntilItIsStopped) {
    AsioMainQueue queue;
    bool ran = false;
    queue.after(5ms, [&] {
        ran = true;
        queue.stop();
    });
    queue.run();
    EXPECT_TRUE(ran);
}

TEST(AsioMainQueue, AStopBeforeRunMakesItReturnAtOnceAndOnlyOnce) {
    AsioMainQueue queue;
    int blocks = 0;
    queue.async([&] { ++blocks; });
    queue.stop();
    queue.run();
    EXPECT_EQ(blocks, 0);
    queue.async([&] { queue.stop(); });
    queue.run();
    EXPECT_EQ(blocks, 1);
}

TEST(AsioMainQueue, ALoopThatIsNotItsOwnRunsWhatIsReadyUntilItIsStopped) {
    AsioMainQueue queue;
    RunLoop& loop = queue;
    EXPECT_TRUE(loop.runReady()) << "an empty queue has not ended";
    int blocks = 0;
    queue.async([&] {
        ++blocks;
        loop.stop();
        queue.async([&] { ++blocks; });
    });
    EXPECT_FALSE(loop.runReady());
    EXPECT_EQ(blocks, 1);
    EXPECT_TRUE(loop.runReady()) << "a stop counts once";
    EXPECT_EQ(blocks, 2);
    loop.stop();
    EXPECT_FALSE(loop.runReady());
}

TEST(AsioMainQueue, ATurnWaitsForABlockAndRunsWhatIsReady) {
    AsioMainQueue queue;
    std::vector<int> order;
    queue.after(5ms, [&] {
        order.push_back(1);
        queue.async([&] { order.push_back(2); });
    });
    EXPECT_TRUE(queue.runTurn(std::nullopt));
    EXPECT_EQ(order, (std::vector<int>{1, 2}));
}

TEST(AsioMainQueue, ATurnEndsWhenNothingHasComeInItsTime) {
    AsioMainQueue queue;
    bool ran = false;
    queue.after(10min, [&] { ran = true; });
    EXPECT_TRUE(queue.runTurn(1ms));
    EXPECT_FALSE(ran);
}

TEST(AsioMainQueue, ATurnEndsAlthoughBlocksGoOnPostingBlocks) {
    AsioMainQueue queue;
    std::function<void()> again = [&] { queue.async(again); };
    again();
    EXPECT_TRUE(queue.runTurn(0ms));
}

TEST(AsioMainQueue, AStopEndsTheTurnsOnce) {
    AsioMainQueue queue;
    queue.async([&] { queue.stop(); });
    EXPECT_FALSE(queue.runTurn(std::nullopt));
    EXPECT_TRUE(queue.runTurn(0ms));
}

TEST(AsioMainQueue, AnExceptionLeavesATurnAndTheNextGoesOn) {
    AsioMainQueue queue;
    bool ran = false;
    queue.async([] { throw std::runtime_error("broken"); });
    queue.async([&] { ran = true; });
    EXPECT_THROW(queue.runTurn(std::nullopt), std::runtime_error);
    EXPECT_TRUE(queue.runTurn(0ms));
    EXPECT_TRUE(ran);
}

TEST(AsioMainQueue, TimersRunUnderALoopThatIsNotItsOwn) {
    AsioMainQueue queue;
    RunLoop& loop = queue;
    int firings = 0;
    const auto timer = queue.scheduleRepeating(1ms, [&] {
        if (++firings == 3) {
            loop.stop();
        }
    });
    while (loop.runReady()) {
        std::this_thread::yield();
    }
    EXPECT_EQ(firings, 3);
}

TEST(AsioMainQueue, AnExceptionLeavesThroughRunWhichThenGoesOn) {
    AsioMainQueue queue;
    std::vector<int> order;
    queue.async([&] { order.push_back(1); });
    queue.async([] { throw std::runtime_error("a fatal record"); });
    queue.async([&] {
        order.push_back(2);
        queue.stop();
    });
    EXPECT_THROW(queue.run(), std::runtime_error);
    EXPECT_EQ(order, (std::vector<int>{1}));
    queue.run();
    EXPECT_EQ(order, (std::vector<int>{1, 2}));
}

TEST(AsioMainQueue, BlocksMayComeFromAnotherThread) {
    AsioMainQueue queue;
    std::thread other([&] { queue.async([&] { queue.stop(); }); });
    queue.run();
    other.join();
}

TEST(AsioMainQueue, ARepeatingTimerFiresUntilItIsInvalidated) {
    AsioMainQueue queue;
    int firings = 0;
    std::unique_ptr<RepeatingTimer> timer;
    timer = queue.scheduleRepeating(1ms, [&] {
        if (++firings == 3) {
            timer->invalidate();
            queue.after(5ms, [&] { queue.stop(); });
        }
    });
    queue.run();
    EXPECT_EQ(firings, 3);
}

TEST(AsioMainQueue, ARepeatingTimerMayBeDestroyedInItsActionAndGoesOnAfterAnException) {
    AsioMainQueue queue;
    int firings = 0;
    std::unique_ptr<RepeatingTimer> timer;
    timer = queue.scheduleRepeating(1ms, [&] {
        if (++firings == 1) {
            throw std::runtime_error("once");
        }
        timer.reset();
        queue.stop();
    });
    EXPECT_THROW(queue.run(), std::runtime_error);
    queue.run();
    EXPECT_EQ(firings, 2);
}

TEST(AsioMainQueue, FiringsThatABusyQueueMissedAreLeftOut) {
    AsioMainQueue queue;
    int firings = 0;
    const auto timer = queue.scheduleRepeating(2ms, [&] { ++firings; });
    std::this_thread::sleep_for(30ms); // the queue is busy
    queue.runReady();
    EXPECT_EQ(firings, 1);
}

TEST(AsioMainQueue, ASignalIsABlock) {
    AsioMainQueue queue;
    int received = 0;
    queue.onSignal({SIGUSR1, SIGTERM}, [&](int number) {
        received = number;
        queue.stop();
    });
    queue.async([] { (void)std::raise(SIGTERM); });
    queue.run();
    EXPECT_EQ(received, SIGTERM);
}

struct TestPipe {
    TestPipe() {
        std::array<int, 2> ends{};
        EXPECT_EQ(::pipe(ends.data()), 0);
        read = Descriptor(ends[0]);
        write = Descriptor(ends[1]);
    }
    Descriptor read;
    Descriptor write;
};

TEST(DescriptorWatch, TellsOnceWhenThereIsSomethingToRead) {
    AsioMainQueue queue;
    const TestPipe pipe;
    DescriptorWatch watch(queue, pipe.read.number());
    int calls = 0;
    watch.onceReadable([&] { ++calls; });
    queue.runReady();
    EXPECT_EQ(calls, 0);
    ASSERT_EQ(::write(pipe.write.number(), "ab", 2), 2);
    queue.runReady();
    queue.runReady();
    EXPECT_EQ(calls, 1);
    watch.onceReadable([&] { ++calls; }); // still unread
    queue.runReady();
    EXPECT_EQ(calls, 2);
}

TEST(DescriptorWatch, ADestroyedWatchTellsNothing) {
    AsioMainQueue queue;
    const TestPipe pipe;
    std::optional<DescriptorWatch> watch;
    watch.emplace(queue, pipe.write.number());
    int calls = 0;
    watch->onceWritable([&] { ++calls; });
    watch.reset();
    queue.runReady();
    EXPECT_EQ(calls, 0);
    watch.emplace(queue, pipe.write.number()); // the descriptor is still open
    watch->onceWritable([&] {
        ++calls;
        watch.reset();
    });
    queue.runReady();
    EXPECT_EQ(calls, 1);
}

} // namespace
} // namespace pallax
