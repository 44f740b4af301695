#include "ui/curses/CursesTerminal.h"

#include "text/Base64.h"
#include "text/Utf8.h"
#include "ui/curses/Curses.h"
#include "ui/curses/CursesCapability.h"
#include "ui/curses/CursesKeys.h"
#include "ui/curses/MouseReports.h"
#include "ui/curses/TerminalRestorer.h"
#include "ui/drawing/Tints.h"

#include <array>
#include <clocale>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <langinfo.h>
#include <poll.h>
#include <sys/ioctl.h>
#include <unistd.h>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr short kAccentPair = 1;

/// Milliseconds in which an escape sequence must be complete, even over a slow network.
constexpr int kEscapeDelay = 100;

/// Opened again for the keys, even if it is standard input: waiting on a descriptor may make it
/// non-blocking, which must not affect other users of standard input.
constexpr const char* kControllingTerminal = "/dev/tty";

struct FileCloser {
    void operator()(std::FILE* file) const { (void)std::fclose(file); }
};
using OwnedFile = std::unique_ptr<std::FILE, FileCloser>;

/// Empty if it is not known.
std::string_view terminalType() {
    const char* type = std::getenv("TERM");
    return type == nullptr ? std::string_view() : type;
}

/// The sequence that restores the screen: attributes off, cursor visible, keypad and mouse off,
/// normal screen.
std::string restoringSequence() {
    std::string sequence =
        terminalCapability("sgr0") + terminalCapability("cnorm") + terminalCapability("rmkx");
    if (!terminalCapability("kmous").empty()) {
        sequence += kNoMouseReports;
    }
    return sequence + terminalCapability("rmcup") + "\r\n";
}

/// Delays Ctrl-Z while it lives. The library ignores Ctrl-Z while it draws, so it would be lost;
/// instead it takes effect after the drawing.
class HeldSuspension {
public:
    HeldSuspension() {
        sigset_t suspension;
        (void)::sigemptyset(&suspension);
        (void)::sigaddset(&suspension, SIGTSTP);
        (void)::sigprocmask(SIG_BLOCK, &suspension, &_before);
    }
    ~HeldSuspension() { (void)::sigprocmask(SIG_SETMASK, &_before, nullptr); }
    HeldSuspension(const HeldSuspension&) = delete;
    HeldSuspension& operator=(const HeldSuspension&) = delete;

private:
    sigset_t _before{};
};

bool isUtf8Locale() {
    return std::string_view(::nl_langinfo(CODESET)) == "UTF-8";
}

/// Whether the locale says nothing about characters beyond ASCII.
bool isPlainLocale() {
    return std::string_view(::nl_langinfo(CODESET)) == "ANSI_X3.4-1968";
}

/// The event of a report in three characters, which are read now.
std::optional<KeyEvent> mouseEventAfterM() {
    std::array<wint_t, 3> characters{};
    bool isComplete = true;
    for (wint_t& character : characters) {
        isComplete = isComplete && ::get_wch(&character) == OK;
    }
    ::nodelay(::stdscr, TRUE);
    return isComplete ? mouseEventOfCharacters(characters[0], characters[1], characters[2])
                      : std::nullopt;
}

/// The key after an escape character that the library has read on its own: the rest of a control
/// sequence that it does not know, or nothing.
std::optional<KeyEvent> keyAfterEscape() {
    constexpr char32_t kFirstFinal = 0x40;
    constexpr char32_t kEscape = 0x1B;
    wint_t code = 0;
    if (::get_wch(&code) != OK) {
        return KeyEvent{.key = Key::Escape};
    }
    if (code != U'[' && code != U'O') {
        ::unget_wch(static_cast<wchar_t>(code)); // a key pressed right after the other
        return keyOfCharacter(kEscape);
    }
    const bool isControl = code == U'[';
    std::string parameters;
    ::wtimeout(::stdscr, kEscapeDelay);
    while (::get_wch(&code) == OK && code < kFirstFinal) {
        parameters += static_cast<char>(code);
    }
    if (isControl && parameters.empty() && code == U'M') {
        return mouseEventAfterM();
    }
    ::nodelay(::stdscr, TRUE);
    return parameters.starts_with('<') ? mouseEvent(parameters, code)
                                       : keyOfSequence(parameters, code);
}

bool wantsColor(ColorUse use) {
    const char* refusal = std::getenv("NO_COLOR");
    return use == ColorUse::Always ||
           (use == ColorUse::Auto && (refusal == nullptr || *refusal == '\0'));
}

/// A cell's text in the library's form: a character and a few combining ones.
std::array<wchar_t, CCHARW_MAX + 1> wideText(std::string_view text, bool asciiOnly) {
    std::array<wchar_t, CCHARW_MAX + 1> wide{};
    std::size_t count = 0;
    for (std::size_t at = 0; at < text.size() && count < CCHARW_MAX;) {
        const Utf8CodePoint codePoint = utf8At(text, at);
        const bool isForeign = asciiOnly && codePoint.value > 0x7F;
        wide.at(count++) = isForeign ? L'?' : static_cast<wchar_t>(codePoint.value);
        at += codePoint.size;
        if (asciiOnly) {
            break;
        }
    }
    return wide;
}

} // namespace

struct CursesTerminal::Impl {
    OwnedFile input;
    SCREEN* screen = nullptr;
    bool hasAccentColor = false;
    std::array<short, kTints> tintPairs{}; ///< 0, the default colours, where a tint has none
    bool isUtf8 = false;
    std::unique_ptr<TerminalRestorer> restorer;
    std::optional<MouseReports> mouseReports;
    std::optional<KeyEvent> readAhead; ///< after the last position of a drag

    attr_t attributesOf(Style style) const {
        attr_t attributes = A_NORMAL;
        attributes |= style.bold ? A_BOLD : A_NORMAL;
        attributes |= style.dim ? A_DIM : A_NORMAL;
        attributes |= style.underline ? A_UNDERLINE : A_NORMAL;
        attributes |= style.accent && !hasAccentColor ? A_REVERSE : A_NORMAL;
        return attributes;
    }

    /// Colours on the terminal's own background.
    void startColors() {
        ::use_default_colors();
        hasAccentColor = ::init_pair(kAccentPair, COLOR_CYAN, -1) == OK;
        for (std::size_t tint = 1; tint < kTints; ++tint) {
            const auto pair = static_cast<short>(kAccentPair + tint);
            const auto color = colorOf(static_cast<Tint>(tint), COLORS);
            if (color && ::init_extended_pair(pair, *color, -1) == OK) {
                tintPairs.at(tint) = pair;
            }
        }
    }

    short pairOf(Style style) const {
        if (style.accent) {
            return hasAccentColor ? kAccentPair : short{0};
        }
        return tintPairs.at(static_cast<std::size_t>(style.tint));
    }

    void showCell(const Grid::Cell& cell, int x, int y) const {
        const auto text = wideText(cell.text, !isUtf8);
        const short pair = pairOf(cell.style);
        cchar_t character{};
        ::setcchar(&character, text.data(), attributesOf(cell.style), pair, nullptr);
        ::mvadd_wch(y, x, &character);
    }
};

bool CursesTerminal::isPossible() {
    const std::string_view type = terminalType();
    return ::isatty(STDOUT_FILENO) != 0 && !type.empty() && type != "dumb";
}

Result<std::unique_ptr<CursesTerminal>, TerminalError>
CursesTerminal::open(const Options& options) {
    (void)std::setlocale(LC_CTYPE, ""); // numbers keep the C locale's form
    auto impl = std::make_unique<Impl>();
    impl->isUtf8 = isUtf8Locale();
    if (isPlainLocale()) {
        // Typed text is most likely still UTF-8; the screen stays ASCII.
        (void)std::setlocale(LC_CTYPE, "C.UTF-8");
    }
    impl->input.reset(std::fopen(kControllingTerminal, "re"));
    if (!impl->input) {
        return TerminalError{"There is no terminal to read keys from; --print needs none."};
    }
    impl->restorer = std::make_unique<TerminalRestorer>(STDOUT_FILENO);
    impl->screen = ::newterm(nullptr, stdout, impl->input.get());
    if (impl->screen == nullptr) {
        return TerminalError{"The terminal type \"" + std::string(terminalType()) +
                             "\" (TERM) is unknown; --print needs no terminal."};
    }
    impl->restorer->setSequence(restoringSequence());
    ::cbreak();
    ::noecho();
    ::nonl();
    ::nodelay(::stdscr, TRUE);
    ::keypad(::stdscr, TRUE);
    if (std::getenv("ESCDELAY") == nullptr) {
        ::set_escdelay(kEscapeDelay);
    }
    if (wantsColor(options.color) && ::has_colors() && ::start_color() == OK) {
        impl->startColors();
    }
    ::keyok(KEY_MOUSE, FALSE); // its sequences are read below
    if (options.mouse && !terminalCapability("kmous").empty()) {
        impl->mouseReports.emplace();
    }
    return std::unique_ptr<CursesTerminal>(new CursesTerminal(std::move(impl)));
}

CursesTerminal::CursesTerminal(std::unique_ptr<Impl> impl) : _impl(std::move(impl)) {}

CursesTerminal::~CursesTerminal() {
    _impl->mouseReports.reset();
    ::endwin();
    ::delscreen(_impl->screen);
}

int CursesTerminal::columns() const {
    return ::getmaxx(::stdscr);
}

int CursesTerminal::rows() const {
    return ::getmaxy(::stdscr);
}

const Marks& CursesTerminal::marks() const {
    if (!_impl->isUtf8) {
        return kAsciiMarks;
    }
    return terminalType().starts_with("linux") ? kConsoleMarks : kUtf8Marks;
}

int CursesTerminal::inputDescriptor() const {
    return ::fileno(_impl->input.get());
}

void CursesTerminal::adoptSize() {
    winsize size{};
    if (::ioctl(STDOUT_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_row > 0 && size.ws_col > 0) {
        ::resizeterm(size.ws_row, size.ws_col);
    }
    if (_impl->mouseReports) {
        MouseReports::ask();
    }
}

void CursesTerminal::show(const Grid& grid) {
    ::erase();
    for (int y = 0; y < grid.rows(); ++y) {
        for (int x = 0; x < grid.columns(); ++x) {
            if (!grid.at(x, y).text.empty()) {
                _impl->showCell(grid.at(x, y), x, y);
            }
        }
    }
    ::curs_set(grid.cursor() ? 1 : 0);
    if (grid.cursor()) {
        ::move(grid.cursor()->y, grid.cursor()->x);
    }
    ::wnoutrefresh(::stdscr);
    const HeldSuspension held;
    ::doupdate();
}

void CursesTerminal::repaint() {
    ::clearok(::stdscr, TRUE);
}

std::optional<KeyEvent> CursesTerminal::read() {
    std::optional<KeyEvent> event =
        _impl->readAhead ? std::exchange(_impl->readAhead, std::nullopt) : readOne();
    while (event && event->key == Key::Drag) {
        _impl->readAhead = readOne();
        if (!_impl->readAhead || _impl->readAhead->key != Key::Drag) {
            break;
        }
        event = std::exchange(_impl->readAhead, std::nullopt);
    }
    return event;
}

std::optional<KeyEvent> CursesTerminal::readOne() {
    wint_t code = 0;
    for (;;) {
        const int kind = ::get_wch(&code);
        if (kind == ERR) {
            return std::nullopt;
        }
        const std::optional<KeyEvent> character = keyOfCharacter(code);
        const bool isEscape = kind == OK && character->key == Key::Escape;
        const std::optional<KeyEvent> key = kind == KEY_CODE_YES ? keyOfCode(code)
                                            : isEscape           ? keyAfterEscape()
                                                                 : character;
        if (key) {
            return key;
        }
    }
}

bool CursesTerminal::isHungUp() const {
    pollfd input{inputDescriptor(), POLLIN, 0};
    return ::poll(&input, 1, 0) > 0 && (input.revents & (POLLHUP | POLLERR | POLLNVAL)) != 0;
}

void CursesTerminal::ringBell() {
    ::beep();
}

void CursesTerminal::copy(std::string_view text) {
    const ByteBuffer bytes(text.begin(), text.end());
    const std::string sequence = "\x1b]52;c;" + base64Text(bytes) + "\a";
    (void)std::fwrite(sequence.data(), 1, sequence.size(), stdout);
    (void)std::fflush(stdout);
}

} // namespace pallax::terminal
