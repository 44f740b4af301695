#include "host/Interruption.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstddef>
#include <ctime>
#include <utility>

namespace pallax {

namespace {

using Handler = void (*)(int);

constexpr std::array kEnding{SIGINT, SIGTERM, SIGHUP, SIGQUIT};
/// How often blocked calls are interrupted; short enough that several in a row, such as lines to a
/// stalled standard error, end soon.
constexpr std::chrono::milliseconds kInterval{10};

/// A signal handler can only access globals.
struct State {
    volatile std::sig_atomic_t signal = 0;
    volatile std::sig_atomic_t ticks = 0;
    bool isActive = false;
    timer_t timer{};
    timespec untilDue{};
    timespec interval{};
    std::sig_atomic_t mostTicks = 0;                // for a program that SIGQUIT must end
    std::array<Handler, kEnding.size()> handlers{}; // the signals' previous handlers, or null
    Interruption::Terminal terminal{};
    struct sigaction alarmBefore {};
};
State state;

timespec timeOf(std::chrono::milliseconds time) {
    const auto seconds = std::chrono::floor<std::chrono::seconds>(time);
    return {seconds.count(), std::chrono::nanoseconds(time - seconds).count()};
}

/// The signal's index among the ending ones, or their number.
std::size_t placeOf(int signal) {
    const auto* found = std::find(kEnding.begin(), kEnding.end(), signal);
    return static_cast<std::size_t>(found - kEnding.begin());
}

} // namespace

extern "C" {
/// These call only functions that are safe in a signal handler.
static void endIsAsked(int signal) {
    const int error = errno;
    if (state.signal == 0) {
        state.signal = signal;
        const itimerspec ticks{state.interval, state.untilDue};
        (void)::timer_settime(state.timer, 0, &ticks, nullptr);
    }
    if (const Handler handler = state.handlers[placeOf(signal)]) { // NOLINT: the place is known
        handler(signal);
    }
    errno = error;
}

static void interrupt(int signal) {
    const int error = errno;
    if (state.signal == 0) { // not ours: do what it did before
        (void)::sigaction(SIGALRM, &state.alarmBefore, nullptr);
        (void)std::raise(signal); // takes effect after this handler
        return;
    }
    state.ticks = state.ticks + 1;
    if (state.terminal.release != nullptr) {
        state.terminal.release();
    }
    if (state.signal == SIGQUIT && state.ticks > state.mostTicks) {
        if (state.terminal.restore != nullptr) {
            state.terminal.restore();
        }
        (void)std::signal(SIGQUIT, SIG_DFL);
        (void)std::raise(SIGQUIT); // takes effect after this handler
    }
    errno = error;
}
}

Interruption::Interruption(Terminal terminal, Patience patience) {
    state.signal = 0;
    state.ticks = 0;
    state.handlers = {};
    state.terminal = terminal;
    state.untilDue = timeOf(patience.untilDue);
    state.interval = timeOf(kInterval);
    state.mostTicks =
        static_cast<std::sig_atomic_t>((patience.untilDeath - patience.untilDue) / kInterval);
    struct sigaction action {};
    action.sa_handler = interrupt; // without SA_RESTART, to interrupt calls
    (void)::sigfillset(&action.sa_mask);
    (void)::sigaction(SIGALRM, &action, &state.alarmBefore);
    sigset_t alarm;
    (void)::sigemptyset(&alarm);
    (void)::sigaddset(&alarm, SIGALRM);
    (void)::sigprocmask(SIG_UNBLOCK, &alarm, nullptr); // a parent may have blocked it
    state.isActive = ::timer_create(CLOCK_MONOTONIC, nullptr, &state.timer) == 0;
}

Interruption::~Interruption() {
    if (state.isActive) {
        (void)::timer_delete(state.timer);
    }
    (void)std::signal(SIGALRM, SIG_IGN); // one that is pending
    (void)::sigaction(SIGALRM, &state.alarmBefore, nullptr);
    state.isActive = false;
    state.ticks = 0;
    if (std::exchange(state.signal, 0) == SIGQUIT) {
        (void)std::signal(SIGQUIT, SIG_DFL);
        (void)std::raise(SIGQUIT);
    }
}

void Interruption::watch(int signal) {
    const std::size_t place = placeOf(signal);
    struct sigaction present {};
    if (!state.isActive || place == kEnding.size() || ::sigaction(signal, nullptr, &present) != 0 ||
        present.sa_handler == endIsAsked) {
        return;
    }
    state.handlers.at(place) = present.sa_handler;
    struct sigaction action {};
    action.sa_handler = endIsAsked;
    action.sa_flags = static_cast<int>(SA_RESTART); // calls do not give up yet
    (void)::sigfillset(&action.sa_mask);
    (void)::sigaction(signal, &action, nullptr);
}

int Interruption::signal() {
    return state.signal;
}

bool Interruption::isDue() {
    return state.ticks > 0;
}

} // namespace pallax
