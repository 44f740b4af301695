#include "ui/curses/TerminalRestorer.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <functional>
#include <poll.h>
#include <string>
#include <sys/resource.h>
#include <sys/wait.h>
#include <termios.h>
#include <thread>
#include <unistd.h>

namespace pallax::terminal {
namespace {

/// A pseudo-terminal: the process under test draws on `terminal`, the test reads at `master`.
class TerminalRestorerTest : public testing::Test {
protected:
    TerminalRestorerTest() {
        master = ::posix_openpt(O_RDWR | O_NOCTTY);
        if (master >= 0 && ::grantpt(master) == 0 && ::unlockpt(master) == 0) {
            terminal = ::open(::ptsname(master), O_RDWR | O_NOCTTY);
        }
    }
    ~TerminalRestorerTest() override {
        (void)::close(terminal);
        (void)::close(master);
    }
    void SetUp() override { ASSERT_GE(terminal, 0); }

    static bool echoes(int descriptor) {
        termios modes{};
        return ::tcgetattr(descriptor, &modes) == 0 && (modes.c_lflag & ECHO) != 0;
    }
    static void switchEchoOff(int descriptor) {
        termios modes{};
        (void)::tcgetattr(descriptor, &modes);
        modes.c_lflag &= ~static_cast<tcflag_t>(ECHO | ICANON);
        (void)::tcsetattr(descriptor, TCSANOW, &modes);
    }

    /// Stops the terminal, like the user's Ctrl-S, which takes effect a moment later.
    void stop() const {
        EXPECT_EQ(::write(master, "\x13", 1), 1);
        pollfd room{terminal, POLLOUT, 0};
        constexpr int kMostLooks = 10'000;
        for (int looks = 0; looks<kMostLooks&& ::poll(&room, 1, 0)> 0; ++looks) {
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        }
        EXPECT_EQ(::poll(&room, 1, 0), 0) << "it is not stopped";
    }

    /// Runs `action` in a process and returns the signal that killed it, or 0.
    int signalAfter(const std::function<void()>& action) const {
        const pid_t child = ::fork();
        if (child == 0) {
            const rlimit none{0, 0};
            (void)::setrlimit(RLIMIT_CORE, &none);
            for (const int signal : {SIGSEGV, SIGBUS, SIGFPE, SIGILL, SIGABRT, SIGQUIT}) {
                (void)std::signal(signal, SIG_DFL); // instead of a sanitizer's handler
            }
            action();
            ::_exit(0);
        }
        int status = 0;
        EXPECT_EQ(::waitpid(child, &status, 0), child);
        return WIFSIGNALED(status) ? WTERMSIG(status) : 0;
    }

    /// The output on the terminal.
    std::string written() const {
        (void)::fcntl(master, F_SETFL, O_NONBLOCK);
        std::array<char, 1024> bytes{};
        const ssize_t size = ::read(master, bytes.data(), bytes.size());
        return {bytes.data(), static_cast<std::size_t>(std::max<ssize_t>(size, 0))};
    }

    int master = -1;
    int terminal = -1;
};

TEST_F(TerminalRestorerTest, RestoresTheTerminalAtEveryDeadlySignalAndDiesOfIt) {
    for (const int signal : {SIGSEGV, SIGBUS, SIGFPE, SIGILL, SIGABRT, SIGQUIT}) {
        EXPECT_EQ(signalAfter([this, signal] {
                      TerminalRestorer restorer(terminal);
                      restorer.setSequence("\x1b[?1049l");
                      switchEchoOff(terminal);
                      (void)std::raise(signal);
                  }),
                  signal);
        EXPECT_EQ(written(), "\x1b[?1049l") << signal;
        EXPECT_TRUE(echoes(terminal)) << signal;
    }
}

TEST_F(TerminalRestorerTest, RestoresTheTerminalAtATerminationSignalWithoutAHandler) {
    for (const int signal : {SIGINT, SIGTERM, SIGHUP, SIGQUIT}) {
        EXPECT_EQ(signalAfter([&] {
                      const TerminalRestorer restorer(terminal);
                      switchEchoOff(terminal);
                      (void)std::signal(signal, SIG_DFL); // like a queue that ends
                      TerminalRestorer::guardEndings();
                      (void)std::raise(signal);
                  }),
                  signal);
        EXPECT_TRUE(echoes(terminal)) << signal;
    }
}

TEST_F(TerminalRestorerTest, RestoresTheTerminalAtAnAbort) {
    EXPECT_EQ(signalAfter([this] {
                  TerminalRestorer restorer(terminal);
                  restorer.setSequence("restored");
                  switchEchoOff(terminal);
                  std::abort();
              }),
              SIGABRT);
    EXPECT_EQ(written(), "restored");
    EXPECT_TRUE(echoes(terminal));
}

TEST_F(TerminalRestorerTest, WritesNothingUntilItKnowsWhat) {
    EXPECT_EQ(signalAfter([this] {
                  TerminalRestorer restorer(terminal);
                  switchEchoOff(terminal);
                  (void)std::raise(SIGABRT);
              }),
              SIGABRT);
    EXPECT_EQ(written(), "");
    EXPECT_TRUE(echoes(terminal));
}

TEST_F(TerminalRestorerTest, ASecondSequenceReplacesTheFirstAndALongOneIsCut) {
    EXPECT_EQ(signalAfter([this] {
                  TerminalRestorer restorer(terminal);
                  restorer.setSequence("first");
                  restorer.setSequence(std::string(1000, 'x'));
                  (void)std::raise(SIGABRT);
              }),
              SIGABRT);
    EXPECT_EQ(written(), std::string(256, 'x'));
}

TEST_F(TerminalRestorerTest, GivesTheSignalsBackAtItsEnd) {
    EXPECT_EQ(signalAfter([this] {
                  {
                      TerminalRestorer restorer(terminal);
                      restorer.setSequence("restored");
                  }
                  (void)std::raise(SIGABRT);
              }),
              SIGABRT);
    EXPECT_EQ(written(), "");
}

TEST_F(TerminalRestorerTest, WhatIsNoTerminalIsOnlyWrittenTo) {
    std::array<int, 2> ends{};
    ASSERT_EQ(::pipe(ends.data()), 0);
    EXPECT_EQ(signalAfter([&ends] {
                  TerminalRestorer restorer(ends[1]);
                  restorer.setSequence("restored");
                  (void)std::raise(SIGABRT);
              }),
              SIGABRT);
    std::array<char, 16> bytes{};
    EXPECT_EQ(::read(ends[0], bytes.data(), bytes.size()), 8);
    EXPECT_EQ(std::string(bytes.data()), "restored");
    (void)::close(ends[0]);
    (void)::close(ends[1]);
}

TEST_F(TerminalRestorerTest, RestoresATerminalThatIsStopped) {
    EXPECT_EQ(signalAfter([this] {
                  constexpr unsigned kTooLong = 20; // seconds
                  (void)::alarm(kTooLong);
                  TerminalRestorer restorer(terminal);
                  restorer.setSequence("restored");
                  stop();
                  (void)std::raise(SIGABRT);
              }),
              SIGABRT);
    EXPECT_EQ(written(), "restored");
}

TEST_F(TerminalRestorerTest, ReleasesOutputThatIsHeldBack) {
    TerminalRestorer::release(); // has no effect without a restorer
    TerminalRestorer restorer(terminal);
    (void)::fcntl(terminal, F_SETFL, O_NONBLOCK);
    stop();
    ASSERT_LT(::write(terminal, "x", 1), 0);
    TerminalRestorer::release();
    EXPECT_EQ(::write(terminal, "x", 1), 1) << "it was stopped";
    while (::write(terminal, "yyyyyyyy", 8) > 0) {
    }
    TerminalRestorer::release();
    EXPECT_EQ(::write(terminal, "x", 1), 1) << "it was full";
}

TEST_F(TerminalRestorerTest, LeavesAProcessThatDoesNotDieAlone) {
    EXPECT_EQ(signalAfter([this] {
                  TerminalRestorer restorer(terminal);
                  restorer.setSequence("restored");
                  switchEchoOff(terminal);
              }),
              0);
    EXPECT_EQ(written(), "");
    EXPECT_FALSE(echoes(terminal));
}

} // namespace
} // namespace pallax::terminal
