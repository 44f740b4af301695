#include "window/GlibTurns.h"

#include "tests/window/OnceAfter.h"

#include <gtest/gtest.h>

#include <array>
#include <chrono>
#include <glib-unix.h>
#include <stdexcept>
#include <unistd.h>

namespace pallax {
namespace {

using doubles::onceAfter;
using namespace std::chrono_literals;

TEST(GlibTurns, BlocksOfBothLoopsRunUntilTheQueueIsStopped) {
    AsioMainQueue queue;
    GlibTurns turns(queue);
    std::vector<int> order;
    queue.after(5ms, [&] {
        order.push_back(1);
        onceAfter(5, [&] {
            order.push_back(2);
            queue.async([&] {
                order.push_back(3);
                queue.stop();
            });
        });
    });
    turns.run();
    EXPECT_EQ(order, (std::vector<int>{1, 2, 3}));
}

/// Runs until GLib sees that a new pipe can be read; hangs if it does not see it.
void runUntilReadable(AsioMainQueue& queue, GlibTurns& turns) {
    std::array<int, 2> pipe{};
    ASSERT_EQ(::pipe(pipe.data()), 0);
    g_unix_fd_add(
        pipe[0], G_IO_IN,
        +[](gint /*descriptor*/, GIOCondition /*condition*/, gpointer data) -> gboolean {
            static_cast<AsioMainQueue*>(data)->stop();
            return G_SOURCE_REMOVE;
        },
        &queue);
    queue.after(1ms, [&] { EXPECT_EQ(::write(pipe[1], "x", 1), 1); });
    turns.run();
    (void)::close(pipe[0]);
    (void)::close(pipe[1]);
}

TEST(GlibTurns, ADescriptorThatGlibWatchesEndsTheWait) {
    AsioMainQueue queue;
    GlibTurns turns(queue);
    runUntilReadable(queue, turns);
}

TEST(GlibTurns, ADescriptorThatIsClosedAndOpenedAgainIsWatchedAgain) {
    AsioMainQueue queue;
    GlibTurns turns(queue);
    for (int round = 0; round < 3; ++round) {
        runUntilReadable(queue, turns);
    }
}

TEST(GlibTurns, GlibGetsItsTurnWhileBlocksPostBlocks) {
    AsioMainQueue queue;
    GlibTurns turns(queue);
    std::function<void()> again = [&] { queue.async(again); };
    again();
    onceAfter(1, [&] { queue.stop(); });
    turns.run();
}

TEST(GlibTurns, AnExceptionOfABlockLeavesAndTheLoopsCanGoOn) {
    AsioMainQueue queue;
    GlibTurns turns(queue);
    queue.async([] { throw std::runtime_error("broken"); });
    EXPECT_THROW(turns.run(), std::runtime_error);
    onceAfter(1, [&] { queue.stop(); });
    turns.run();
}

TEST(GlibTurns, NothingRunsWhileNothingHappens) {
    AsioMainQueue queue;
    GlibTurns turns(queue);
    const std::clock_t before = std::clock();
    queue.after(300ms, [&] { queue.stop(); });
    turns.run();
    const double used = static_cast<double>(std::clock() - before) / CLOCKS_PER_SEC;
    EXPECT_LT(used, 0.1) << "it turns without waiting";
}

} // namespace
} // namespace pallax
