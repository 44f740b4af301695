#include "tests/cli/PallaxTerminal.h"

#include <gtest/gtest.h>

#include <array>
#include <chrono>
#include <csignal>
#include <cstdlib>
#include <poll.h>
#include <pty.h>
#include <sys/ioctl.h>
#include <sys/wait.h>
#include <termios.h>
#include <thread>
#include <unistd.h>
#include <utility>

namespace pallax::doubles {

namespace {

constexpr std::chrono::seconds kScreenPatience{30};

winsize sizeOf(int columns, int rows) {
    winsize size{};
    size.ws_col = static_cast<unsigned short>(columns);
    size.ws_row = static_cast<unsigned short>(rows);
    return size;
}

} // namespace

PallaxTerminal::PallaxTerminal(const World& world, std::vector<std::string> arguments,
                               const Setup& setup)
    : _screen(setup.columns, setup.rows) {
    arguments.insert(arguments.begin(), setup.program.empty() ? programPath() : setup.program);
    std::vector<std::string> environment = programEnvironment(world);
    environment.insert(environment.end(),
                       {"TERM=" + setup.type, "LC_ALL=" + setup.locale, "PS1=$ "});
    winsize size = sizeOf(setup.columns, setup.rows);
    const std::vector<char*> words = pointersTo(arguments);
    const std::vector<char*> settings = pointersTo(environment);
    _process = ::forkpty(&_terminal, nullptr, nullptr, &size);
    if (_process == 0) {
        (void)::execve(words.front(), words.data(), settings.data());
        ::_exit(127);
    }
}

PallaxTerminal::~PallaxTerminal() {
    if (_process > 0) {
        (void)::kill(_process, SIGKILL);
        (void)::waitpid(_process, nullptr, 0);
    }
    (void)::close(_terminal);
}

void PallaxTerminal::type(const std::string& keys) const {
    EXPECT_EQ(::write(_terminal, keys.data(), keys.size()), static_cast<ssize_t>(keys.size()));
}

void PallaxTerminal::resize(int columns, int rows) {
    _screen.resize(columns, rows);
    const winsize size = sizeOf(columns, rows);
    EXPECT_EQ(::ioctl(_terminal, TIOCSWINSZ, &size), 0);
}

void PallaxTerminal::signal(int number) const {
    (void)::kill(_process, number);
}

/// True when bytes have arrived.
bool PallaxTerminal::readFor(int milliseconds) {
    pollfd waiting{_terminal, POLLIN, 0};
    if (_isClosed || ::poll(&waiting, 1, milliseconds) <= 0) {
        return false;
    }
    std::array<char, 4096> buffer{};
    const ssize_t count = ::read(_terminal, buffer.data(), buffer.size());
    if (count <= 0) {
        _isClosed = true; // the last process that had it open has ended
        return false;
    }
    const std::string_view bytes(buffer.data(), static_cast<std::size_t>(count));
    _bytes += bytes;
    _screen.write(bytes);
    return true;
}

bool PallaxTerminal::waitUntil(const std::function<bool()>& condition, const std::string& wanted) {
    const auto end = std::chrono::steady_clock::now() + kScreenPatience;
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end || (!readFor(20) && _isClosed)) {
            ADD_FAILURE() << "waited for " << wanted << "; the screen:\n" << _screen.text();
            return false;
        }
    }
    return true;
}

bool PallaxTerminal::shows(const std::string& text) {
    return waitUntil([&] { return _screen.text().find(text) != std::string::npos; },
                     "\"" + text + "\"");
}

bool PallaxTerminal::showsNoMore(const std::string& text) {
    return waitUntil([&] { return _screen.text().find(text) == std::string::npos; },
                     "no \"" + text + "\"");
}

std::string PallaxTerminal::settled() {
    constexpr int kQuiet = 300;
    while (readFor(kQuiet)) {
    }
    return _screen.text();
}

int PallaxTerminal::wait() {
    const auto end = std::chrono::steady_clock::now() + kScreenPatience;
    int status = 0;
    while (::waitpid(_process, &status, WNOHANG) == 0) {
        (void)readFor(20);
        if (std::chrono::steady_clock::now() > end) {
            ADD_FAILURE() << "it does not end; the screen:\n" << _screen.text();
            signal(SIGKILL);
        }
    }
    _process = -1;
    while (readFor(0)) {
    }
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
}

bool PallaxTerminal::isRestored() const {
    termios modes{};
    return ::tcgetattr(_terminal, &modes) == 0 && (modes.c_lflag & ICANON) != 0 &&
           (modes.c_lflag & ECHO) != 0 && !_screen.isOnOtherScreen();
}

} // namespace pallax::doubles
