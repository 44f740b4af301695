#include "ui/curses/TerminalRestorer.h"

#include <algorithm>
#include <array>
#include <csignal>
#include <cstddef>
#include <termios.h>
#include <unistd.h>

namespace pallax::terminal {

namespace {

constexpr std::array kDeadly{SIGSEGV, SIGBUS, SIGFPE, SIGILL, SIGABRT, SIGQUIT, SIGSYS, SIGTRAP};
constexpr std::array kEnding{SIGINT, SIGTERM, SIGHUP, SIGQUIT};
/// The handler has its own stack, because the normal one may have overflowed.
constexpr std::size_t kStackSize = std::size_t{32} << 10U;
constexpr std::size_t kMaximumSequence = 256;

/// A signal handler can only access globals.
struct Restoration {
    int descriptor = -1;
    termios modes{};
    bool hasModes = false;
    std::array<char, kMaximumSequence> sequence{};
    std::size_t size = 0;
    std::array<char, kStackSize> stack{};
};
Restoration restoration;

} // namespace

extern "C" {
/// Calls only functions that are safe in a signal handler. The signal's default action has been
/// restored.
static void restoreAndDie(int signal) {
    TerminalRestorer::restore();
    (void)std::raise(signal);
}
}

namespace {

template <std::size_t kCount>
void restoreAt(const std::array<int, kCount>& signals) {
    struct sigaction action {};
    action.sa_handler = restoreAndDie;
    action.sa_flags = static_cast<int>(SA_RESETHAND | SA_ONSTACK);
    for (const int signal : signals) {
        (void)::sigaction(signal, &action, nullptr);
    }
}

template <std::size_t kCount>
void giveBack(const std::array<int, kCount>& signals) {
    for (const int signal : signals) {
        (void)std::signal(signal, SIG_DFL);
    }
}

/// Like Ctrl-Q. TCOON only undoes a stop by the program, not by the user, unless it follows TCOOFF.
void goOn(int descriptor) {
    (void)::tcflow(descriptor, TCOOFF);
    (void)::tcflow(descriptor, TCOON);
}

} // namespace

void TerminalRestorer::release() {
    if (restoration.hasModes) {
        (void)::tcflush(restoration.descriptor, TCOFLUSH);
        goOn(restoration.descriptor);
    }
}

void TerminalRestorer::restore() {
    goOn(restoration.descriptor); // otherwise a dying process would wait
    (void)!::write(restoration.descriptor, restoration.sequence.data(), restoration.size);
    if (restoration.hasModes) {
        (void)::tcsetattr(restoration.descriptor, TCSANOW, &restoration.modes);
    }
}

TerminalRestorer::TerminalRestorer(int descriptor) {
    restoration.descriptor = descriptor;
    restoration.hasModes = ::tcgetattr(descriptor, &restoration.modes) == 0;
    restoration.size = 0;
    stack_t stack{};
    stack.ss_sp = restoration.stack.data();
    stack.ss_size = restoration.stack.size();
    (void)::sigaltstack(&stack, nullptr);
    restoreAt(kDeadly);
}

TerminalRestorer::~TerminalRestorer() {
    giveBack(kDeadly);
    giveBack(kEnding);
    stack_t none{};
    none.ss_flags = SS_DISABLE;
    (void)::sigaltstack(&none, nullptr);
    restoration.hasModes = false;
    restoration.size = 0;
}

void TerminalRestorer::guardEndings() {
    restoreAt(kEnding);
}

void TerminalRestorer::setSequence(std::string_view sequence) {
    restoration.size = std::min(sequence.size(), kMaximumSequence);
    std::copy_n(sequence.begin(), restoration.size, restoration.sequence.begin());
}

} // namespace pallax::terminal
