#include "host/Interruption.h"

#include "host/AsioMainQueue.h"
#include "host/Descriptor.h"

#include <gtest/gtest.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <functional>
#include <string>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax {
namespace {

using std::chrono::milliseconds;

constexpr Interruption::Terminal kNoTerminal{nullptr, nullptr};
constexpr Interruption::Patience kShort{milliseconds(20), milliseconds(100)};
constexpr Interruption::Patience kLong{milliseconds(60'000), milliseconds(60'000)};

int releases = 0;
int restorationReport = -1; // a descriptor

void release() {
    ++releases;
}

void restore() {
    (void)!::write(restorationReport, "restored", 8);
}

/// A full pipe, and its write end for the program under test.
class InterruptionTest : public testing::Test {
protected:
    InterruptionTest() {
        std::array<int, 2> ends{};
        EXPECT_EQ(::pipe2(ends.data(), O_CLOEXEC), 0);
        reader = Descriptor(ends[0]);
        writer = Descriptor(ends[1]);
    }
    void SetUp() override {
        (void)::fcntl(writer.number(), F_SETFL, O_NONBLOCK);
        std::array<char, 4096> block{};
        while (::write(writer.number(), block.data(), block.size()) > 0) {
        }
        (void)::fcntl(writer.number(), F_SETFL, 0);
    }

    /// Writes like the program's writers; true when the write was given up.
    bool writeIsGivenUp() const {
        while (::write(writer.number(), "x", 1) < 0 && errno == EINTR) {
            if (Interruption::isDue()) {
                return true;
            }
        }
        return false;
    }

    /// The signal that kills a process running `action`; 0 if none does.
    static int signalAfter(const std::function<void()>& action) {
        const pid_t child = ::fork();
        if (child == 0) {
            const rlimit none{0, 0};
            (void)::setrlimit(RLIMIT_CORE, &none);
            constexpr unsigned kTooLong = 20; // seconds
            (void)::alarm(kTooLong);
            action();
            ::_exit(0);
        }
        int status = 0;
        EXPECT_EQ(::waitpid(child, &status, 0), child);
        return WIFSIGNALED(status) ? WTERMSIG(status) : 0;
    }

    Descriptor reader;
    Descriptor writer;
};

TEST_F(InterruptionTest, ABlockedWriteIsGivenUpAndTheQueueHandlesTheSignal) {
    for (const int number : {SIGINT, SIGTERM, SIGHUP}) {
        const Interruption interruption(kNoTerminal, kShort);
        AsioMainQueue queue;
        int heard = 0;
        queue.onSignal({number}, [&](int signal) {
            heard = signal;
            queue.stop();
        });
        EXPECT_EQ(Interruption::signal(), 0);
        queue.async([&] {
            (void)std::raise(number);
            EXPECT_TRUE(writeIsGivenUp());
        });
        queue.run();
        EXPECT_EQ(heard, number);
        EXPECT_EQ(Interruption::signal(), number);
    }
    EXPECT_FALSE(Interruption::isDue());
    EXPECT_EQ(Interruption::signal(), 0);
}

TEST_F(InterruptionTest, BeforeItIsDueNothingIsInterrupted) {
    const Interruption interruption(kNoTerminal, kLong);
    AsioMainQueue queue;
    queue.onSignal({SIGTERM}, [&](int /*signal*/) { queue.stop(); });
    (void)std::raise(SIGTERM);
    EXPECT_FALSE(Interruption::isDue());
    std::array<char, 4096> block{};
    ASSERT_EQ(::read(reader.number(), block.data(), block.size()), 4096);
    EXPECT_FALSE(writeIsGivenUp()) << "the pipe has room again";
    queue.run();
}

TEST_F(InterruptionTest, AForeignAlarmEndsTheProgramAsWithoutIt) {
    EXPECT_EQ(signalAfter([] {
                  const Interruption interruption(kNoTerminal, kLong);
                  (void)std::raise(SIGALRM);
              }),
              SIGALRM);
}

TEST_F(InterruptionTest, AnAlarmThatTheParentHasBlockedIsHeard) {
    sigset_t alarm;
    (void)::sigemptyset(&alarm);
    (void)::sigaddset(&alarm, SIGALRM);
    (void)::sigprocmask(SIG_BLOCK, &alarm, nullptr);
    const Interruption interruption(kNoTerminal, kShort);
    AsioMainQueue queue;
    queue.onSignal({SIGTERM}, [](int /*signal*/) {});
    (void)std::raise(SIGTERM);
    EXPECT_TRUE(writeIsGivenUp());
}

TEST_F(InterruptionTest, OtherSignalsAskForNoEnd) {
    const Interruption interruption(kNoTerminal, kShort);
    AsioMainQueue queue;
    queue.onSignal({SIGUSR1}, [&](int /*signal*/) { queue.stop(); });
    (void)std::raise(SIGUSR1);
    queue.run();
    EXPECT_EQ(Interruption::signal(), 0);
}

TEST_F(InterruptionTest, ASecondQueueHearsOfTheSignalToo) {
    const Interruption interruption(kNoTerminal, kLong);
    for (int count = 0; count < 2; ++count) {
        AsioMainQueue queue;
        bool isHeard = false;
        queue.onSignal({SIGTERM}, [](int /*signal*/) {});
        queue.onSignal({SIGTERM}, [&](int /*signal*/) {
            isHeard = true;
            queue.stop();
        });
        (void)std::raise(SIGTERM);
        queue.run();
        EXPECT_TRUE(isHeard);
    }
}

TEST_F(InterruptionTest, TheTerminalsOutputIsReleased) {
    releases = 0;
    const Interruption interruption({release, nullptr}, kShort);
    AsioMainQueue queue;
    queue.onSignal({SIGTERM}, [](int /*signal*/) {});
    (void)std::raise(SIGTERM);
    EXPECT_EQ(releases, 0);
    EXPECT_TRUE(writeIsGivenUp());
    EXPECT_GT(releases, 0);
}

TEST_F(InterruptionTest, AProgramThatSigquitHasEndedDiesOfIt) {
    EXPECT_EQ(signalAfter([] {
                  const Interruption interruption(kNoTerminal, kLong);
                  AsioMainQueue queue;
                  queue.onSignal({SIGQUIT}, [&](int /*signal*/) { queue.stop(); });
                  (void)std::raise(SIGQUIT);
                  queue.run();
              }),
              SIGQUIT);
}

TEST_F(InterruptionTest, AProgramThatGoesOnAfterSigquitDiesOfItWithTheTerminalRestored) {
    std::array<int, 2> ends{};
    ASSERT_EQ(::pipe2(ends.data(), O_CLOEXEC), 0);
    const Descriptor report(ends[0]);
    const Descriptor reporter(ends[1]);
    EXPECT_EQ(signalAfter([&reporter] {
                  restorationReport = reporter.number();
                  const Interruption interruption({release, restore}, kShort);
                  AsioMainQueue queue;
                  queue.onSignal({SIGQUIT}, [](int /*signal*/) {});
                  (void)std::raise(SIGQUIT);
                  for (;;) {
                      (void)::pause();
                  }
              }),
              SIGQUIT);
    std::array<char, 16> text{};
    EXPECT_EQ(::read(report.number(), text.data(), text.size()), 8);
    EXPECT_STREQ(text.data(), "restored");
}

} // namespace
} // namespace pallax
