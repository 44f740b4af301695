#include "ui/curses/MouseReports.h"

#include <array>
#include <charconv>
#include <csignal>
#include <unistd.h>

namespace pallax::terminal {

namespace {

constexpr std::string_view kReports = "\x1b[?1000h\x1b[?1002h\x1b[?1006h";

// The first number of a report.
constexpr unsigned kButton = 0x03;
constexpr unsigned kModifiers = 0x1C;
constexpr unsigned kMotion = 0x20;
constexpr unsigned kWheel = 0x40;
constexpr unsigned kNoButton = 3; ///< in the reports of three characters, it was released

/// What suspends the program: the library's handler. A signal handler can only access globals.
struct sigaction suspension {};

void write(std::string_view sequence) {
    (void)!::write(STDOUT_FILENO, sequence.data(), sequence.size());
}

std::optional<Key> keyOf(unsigned what, bool isPressed) {
    switch (what & ~kModifiers) {
    case 0:
        return isPressed ? Key::Click : Key::Release;
    case kMotion:
        return Key::Drag;
    case kWheel:
        return Key::WheelUp;
    case kWheel | 1U:
        return Key::WheelDown;
    default:
        return std::nullopt;
    }
}

std::optional<KeyEvent> eventAt(std::optional<Key> key, unsigned column, unsigned row) {
    constexpr unsigned kMost = 10000; // no terminal has more columns
    if (!key || column == 0 || row == 0 || column > kMost || row > kMost) {
        return std::nullopt;
    }
    return KeyEvent{.key = *key, .x = static_cast<int>(column) - 1, .y = static_cast<int>(row) - 1};
}

} // namespace

extern "C" {
/// Calls only functions that are safe in a signal handler, and the library's handler.
static void stopReportsAndSuspend(int signal) {
    write(kNoMouseReports);
    suspension.sa_handler(signal);
}
}

MouseReports::MouseReports() {
    (void)::sigaction(SIGTSTP, nullptr, &suspension);
    if (suspension.sa_handler != SIG_DFL && suspension.sa_handler != SIG_IGN) {
        struct sigaction action = suspension;
        action.sa_handler = stopReportsAndSuspend;
        (void)::sigaction(SIGTSTP, &action, nullptr);
    }
    ask();
}

MouseReports::~MouseReports() {
    (void)::sigaction(SIGTSTP, &suspension, nullptr);
    write(kNoMouseReports);
}

void MouseReports::ask() {
    write(kReports);
}

std::optional<KeyEvent> mouseEvent(std::string_view parameters, char32_t final) {
    if (!parameters.starts_with('<') || (final != U'M' && final != U'm')) {
        return std::nullopt;
    }
    std::array<unsigned, 3> numbers{};
    const char* const end = parameters.data() + parameters.size();
    const char* at = parameters.data();
    for (unsigned& number : numbers) {
        if (at == end) {
            return std::nullopt;
        }
        const auto [next, error] = std::from_chars(at + 1, end, number); // after "<" or ";"
        if (error != std::errc()) {
            return std::nullopt;
        }
        at = next;
    }
    return at == end ? eventAt(keyOf(numbers[0], final == U'M'), numbers[1], numbers[2])
                     : std::nullopt;
}

std::optional<KeyEvent> mouseEventOfCharacters(char32_t what, char32_t column, char32_t row) {
    constexpr char32_t kZero = U' ';
    if (what < kZero || column < kZero || row < kZero) {
        return std::nullopt;
    }
    const unsigned number = what - kZero;
    const bool isReleased = (number & ~kModifiers) == kNoButton;
    return eventAt(keyOf(isReleased ? number & ~kButton : number, !isReleased), column - kZero,
                   row - kZero);
}

} // namespace pallax::terminal
