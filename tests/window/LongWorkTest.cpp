#include "window/LongWork.h"

#include "tests/ui/gtk/WindowDump.h"
#include "tests/ui/gtk/XDisplay.h"
#include "tests/window/OnceAfter.h"
#include "window/GlibTurns.h"

#include <chrono>
#include <functional>

namespace pallax {
namespace {

using doubles::onceAfter;
using namespace std::chrono_literals;
using SteadyClock = std::chrono::steady_clock;

class LongWorkTest : public gtk::DisplayTest {};

/// A window in which work asks whether it may go on.
struct Working {
    Working() { gtk_window_present(frame.window()); }

    /// Runs the work as a block, and until the blocks after it have run.
    void run(const std::function<void()>& block) {
        work->begin([this, block] {
            block();
            queue.async([this] { queue.stop(); });
        });
        turns.run();
    }
    /// Asks for so long, or until it may not go on; whether it was stopped.
    bool isStopped(std::chrono::milliseconds length) {
        const auto end = SteadyClock::now() + length;
        while (SteadyClock::now() < end) {
            if (!work->mayGoOn("Working. Esc stops.")) {
                return true;
            }
        }
        return false;
    }
    bool isTold() const { return dump().find("Working. Esc stops.") != std::string::npos; }
    std::string dump() const { return gtk::windowDump(GTK_WIDGET(frame.window())); }

    AsioMainQueue queue;
    GlibTurns turns{queue};
    gtk::Guard guard{queue};
    int closings = 0;
    gtk::MainFrame frame{nullptr, guard, {[this] { ++closings; }}};
    std::unique_ptr<LongWork> work = std::make_unique<LongWork>(queue, frame);
};

TEST_F(LongWorkTest, OfShortWorkNothingIsToldAndNothingIsLeft) {
    Working window;
    window.run([&] {
        EXPECT_FALSE(window.isStopped(30ms));
        EXPECT_FALSE(window.isTold());
    });
    EXPECT_FALSE(window.isTold());
}

TEST_F(LongWorkTest, TheToolkitIsServedButNoOtherBlockRuns) {
    Working window;
    bool isServed = false;
    bool hasBlockRun = false;
    window.run([&] {
        onceAfter(1, [&] { isServed = true; });
        window.queue.async([&] { hasBlockRun = true; });
        EXPECT_FALSE(window.isStopped(300ms));
        EXPECT_TRUE(window.isTold());
        EXPECT_TRUE(isServed);
        EXPECT_FALSE(hasBlockRun);
    });
    EXPECT_TRUE(hasBlockRun);
    EXPECT_FALSE(window.isTold()) << "it is over";
}

TEST_F(LongWorkTest, TheUserStopsItAndTheNextWorkBeginsAfresh) {
    Working window;
    for (int times = 0; times < 2; ++times) {
        window.run([&] {
            onceAfter(150, [&] {
                gboolean isHandled = FALSE;
                g_signal_emit_by_name(window.frame.window(), "close-request", &isHandled);
            });
            const auto begin = SteadyClock::now();
            EXPECT_TRUE(window.isStopped(10s));
            EXPECT_LT(SteadyClock::now() - begin, 5s);
        });
        EXPECT_FALSE(window.isTold());
    }
    EXPECT_EQ(window.closings, 2);
}

TEST_F(LongWorkTest, WorkThatWaitsIsDroppedWithTheObject) {
    Working window;
    bool hasRun = false;
    window.work->begin([&] { hasRun = true; });
    window.work.reset();
    window.queue.async([&] { window.queue.stop(); });
    window.turns.run();
    EXPECT_FALSE(hasRun);
}

} // namespace
} // namespace pallax
