#include "browsing/ScreenBrowser.h"

#include "link/Settings.h"

#include <algorithm>
#include <csignal>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kTurnInterval{150};
constexpr std::chrono::milliseconds kSilentWork{100};
constexpr std::chrono::milliseconds kFrame{50}; // in which all that is typed is drawn once

/// The terminal's marks, with the curves of the settings unless they must be ASCII.
terminal::Marks marksWith(terminal::Marks marks, std::optional<CurveCharacters> curves) {
    if (marks.asciiOnly || !curves) {
        return marks;
    }
    switch (*curves) {
    case CurveCharacters::Braille:
        marks.curves = terminal::Curves::Braille;
        break;
    case CurveCharacters::Blocks:
        marks.curves = terminal::Curves::Blocks;
        break;
    case CurveCharacters::Ascii:
        marks.curves = terminal::Curves::Ascii;
        break;
    }
    return marks;
}

} // namespace

ScreenBrowser::ScreenBrowser(const Setup& setup, std::vector<ScreenSession::Shown> shown)
    : _terminal(setup.terminal), _keys(_queue, setup.terminal.inputDescriptor()),
      _marks(marksWith(setup.terminal.marks(), setup.settings.curves)), _screen(screen(setup)),
      _sessions(sessions(std::move(shown))), _split(splitScreen()) {}

ScreenSession::Screen ScreenBrowser::screen(const Setup& setup) {
    return {.queue = _queue,
            .marks = _marks,
            .notices = setup.notices,
            .settings = setup.settings,
            .profile = setup.profile,
            .onFatalRecord = setup.onFatalRecord,
            .isSafe = setup.isSafe,
            .needsDisplay = [this] { needsDisplay(); },
            .repaint =
                [this] {
                    _terminal.repaint();
                    needsDisplay();
                },
            .copy = [this](const std::string& text) { _terminal.copy(text); },
            .ringBell = [this] { _terminal.ringBell(); },
            .chooseModem = [this](std::size_t number) { _split.choose(number); },
            .switchSafe = [this] { switchSafe(); },
            .mayGoOn = [this](const auto& tell) { return mayGoOn(tell); }};
}

ScreenBrowser::Sessions ScreenBrowser::sessions(std::vector<ScreenSession::Shown> shown) const {
    Sessions sessions;
    sessions.reserve(shown.size());
    for (ScreenSession::Shown& each : shown) {
        sessions.push_back(std::make_unique<ScreenSession>(_screen, std::move(each)));
    }
    return sessions;
}

terminal::SplitScreen ScreenBrowser::splitScreen() {
    std::vector<terminal::SplitScreen::Modem> modems;
    modems.reserve(_sessions.size());
    for (const auto& session : _sessions) {
        modems.push_back({session->name(), session->frontEnd()});
    }
    return {std::move(modems), _marks, [this] { needsDisplay(); }};
}

/// All modems at once, because all are on the screen.
void ScreenBrowser::switchSafe() {
    const auto refuse = [this](const std::string& sentence) {
        for (const auto& session : _sessions) {
            session->frontEnd().setMessage(sentence);
        }
    };
    if (_screen.isSafe) {
        return refuse("The viewer was started with --safe and stays so.");
    }
    for (const auto& session : _sessions) {
        if (!session->canStartAfresh()) {
            return refuse("A stream can be played only once: start the viewer with --safe.");
        }
    }
    _isSafe = !_isSafe;
    for (const auto& session : _sessions) {
        session->setSafe(_isSafe);
    }
}

/// Tells of work that takes long, and looks for the key that stops it.
bool ScreenBrowser::mayGoOn(const std::function<void()>& tell) {
    const auto now = std::chrono::steady_clock::now();
    if (!_workBegan) {
        _workBegan = now;
    }
    if (now - *_workBegan < kSilentWork || now - _lookedForKey < kSilentWork) {
        return true;
    }
    _lookedForKey = now;
    tell();
    _terminal.show(_split.draw());
    while (const auto key = _terminal.read()) {
        if (key->key == terminal::Key::Escape) {
            return false;
        }
        _typedAhead.push_back(*key);
    }
    return true;
}

bool ScreenBrowser::run() {
    // After SIGCONT the terminal may have another extent than before.
    _queue.onSignal({SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGWINCH, SIGCONT}, [this](int signal) {
        if (signal == SIGWINCH || signal == SIGCONT) {
            adoptSize();
        } else {
            _queue.stop();
        }
    });
    _split.resize(_terminal.columns(), _terminal.rows());
    waitForKey();
    for (const auto& session : _sessions) {
        session->start();
    }
    _queue.run();
    return std::none_of(_sessions.begin(), _sessions.end(),
                        [](const auto& session) { return session->hasLostSource(); });
}

void ScreenBrowser::waitForKey() {
    _keys.onceReadable([this] { readKey(); });
}

/// One key at a time: what it posts to the queue comes before the next one.
void ScreenBrowser::readKey() {
    std::optional<terminal::KeyEvent> key;
    if (_typedAhead.empty()) {
        key = _terminal.read();
    } else {
        key = _typedAhead.front();
        _typedAhead.pop_front();
    }
    if (key) {
        _workBegan.reset();
        _split.handle(*key);
        for (const auto& session : _sessions) {
            session->tellTrouble();
        }
        noteTyping(*key);
        _queue.async([this] { readKey(); });
    } else if (_terminal.isHungUp()) {
        _queue.stop();
    } else {
        waitForKey();
    }
}

/// Of characters that come at once, such as a pasted text, not each is drawn.
void ScreenBrowser::noteTyping(const terminal::KeyEvent& key) {
    if (_typedAhead.empty()) {
        if (const auto next = _terminal.read()) {
            _typedAhead.push_back(*next);
        }
    }
    _isTypingOn = key.key == terminal::Key::Character && !_typedAhead.empty() &&
                  _typedAhead.front().key == terminal::Key::Character;
}

void ScreenBrowser::needsDisplay() {
    if (!_isDisplayPosted) {
        _isDisplayPosted = true;
        _queue.async([this] { display(); });
    }
}

void ScreenBrowser::display() {
    const auto now = std::chrono::steady_clock::now();
    if (_isTypingOn && now - _shown < kFrame) {
        return _queue.async([this] { display(); });
    }
    _shown = now;
    _terminal.show(_split.draw());
    _isDisplayPosted = false; // drawing itself asks for no other drawing
    keepTurning();
}

void ScreenBrowser::keepTurning() {
    if (!_split.isAnimated()) {
        _turning.reset();
    } else if (!_turning) {
        _turning = _queue.scheduleRepeating(kTurnInterval, [this] { _split.turn(); });
    }
}

void ScreenBrowser::adoptSize() {
    _terminal.adoptSize();
    _split.resize(_terminal.columns(), _terminal.rows());
}

} // namespace pallax
