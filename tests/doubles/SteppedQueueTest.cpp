#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace pallax::doubles {
namespace {

using namespace std::chrono_literals;

class SteppedQueueTest : public testing::Test {
protected:
    MainQueue::Block note(const std::string& text) {
        return [this, text] {
            seen.push_back(
                text + "@" +
                std::to_string(
                    std::chrono::duration_cast<std::chrono::seconds>(queue.now()).count()));
        };
    }
    using Seen = std::vector<std::string>;

    SteppedQueue queue;
    Seen seen;
};

TEST_F(SteppedQueueTest, BlocksRunOneByOneInTheOrderOfTheirPosting) {
    queue.async(note("a"));
    queue.async(note("b"));
    EXPECT_TRUE(queue.step());
    EXPECT_EQ(seen, Seen{"a@0"});
    EXPECT_TRUE(queue.step());
    EXPECT_FALSE(queue.step());
    EXPECT_EQ(seen, (Seen{"a@0", "b@0"}));
}

TEST_F(SteppedQueueTest, RunReadyRunsWhatIsPostedMeanwhileButNothingOfTheFuture) {
    queue.after(1s, note("later"));
    queue.async([this] { queue.async(note("nested")); });
    queue.runReady();
    EXPECT_EQ(seen, Seen{"nested@0"});
}

TEST_F(SteppedQueueTest, AdvanceRunsWhatFallsDueAtItsOwnTimeInOrder) {
    queue.after(3s, note("c"));
    queue.after(1s, [this] { queue.after(1s, note("b")); });
    queue.after(3s, note("d"));
    queue.async(note("a"));
    queue.advance(3s - 1ns);
    EXPECT_EQ(seen, (Seen{"a@0", "b@2"}));
    queue.advance(1ns);
    EXPECT_EQ(seen, (Seen{"a@0", "b@2", "c@3", "d@3"}));
    EXPECT_EQ(queue.now(), 3s);
}

TEST_F(SteppedQueueTest, ATimerRepeatsUntilItIsInvalidatedOrDestroyed) {
    auto ended = queue.scheduleRepeating(2s, note("invalidated"));
    auto gone = queue.scheduleRepeating(2s, note("destroyed"));
    queue.advance(4s);
    EXPECT_EQ(seen, (Seen{"invalidated@2", "destroyed@2", "invalidated@4", "destroyed@4"}));
    ended->invalidate();
    gone.reset();
    queue.advance(10s);
    EXPECT_EQ(seen.size(), 4U);
}

TEST_F(SteppedQueueTest, ATimerMayBeDestroyedInsideItsOwnAction) {
    std::unique_ptr<RepeatingTimer> timer;
    const std::string text(100, 'x'); // owned by the action, read after the timer's end
    timer = queue.scheduleRepeating(1s, [&timer, this, text] {
        timer.reset();
        seen.push_back(text);
    });
    queue.advance(10s);
    EXPECT_EQ(seen, Seen{text});
}

TEST_F(SteppedQueueTest, AnExceptionLeavesAndTheQueueGoesOn) {
    queue.async([] { throw std::runtime_error("a malformed record"); });
    queue.async(note("next"));
    EXPECT_THROW(queue.runReady(), std::runtime_error);
    queue.runReady();
    EXPECT_EQ(seen, Seen{"next@0"});
}

} // namespace
} // namespace pallax::doubles
