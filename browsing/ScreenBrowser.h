#pragma once

#include "browsing/ScreenSession.h"
#include "ui/curses/CursesTerminal.h"
#include "ui/terminal/SplitScreen.h"

#include <chrono>
#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

namespace pallax {

/// Sessions on the terminal that the process runs in: its keys, its screen, and the signals.
class ScreenBrowser {
public:
    struct Setup {
        const Settings& settings;
        const QualityProfile& profile; ///< judges levels
        OnFatalRecord onFatalRecord;
        bool isSafe;
        terminal::CursesTerminal& terminal;
        StandardOutput& notices;
    };

    /// `shown` is not empty. The references must outlive the browser: errors and notices are
    /// printed once the terminal is restored.
    ScreenBrowser(const Setup& setup, std::vector<ScreenSession::Shown> shown);
    ScreenBrowser(const ScreenBrowser&) = delete;
    ScreenBrowser& operator=(const ScreenBrowser&) = delete;

    /// Runs until the user quits or a signal ends it. False if a child ended before.
    bool run();

private:
    using Sessions = std::vector<std::unique_ptr<ScreenSession>>;

    ScreenSession::Screen screen(const Setup& setup);
    Sessions sessions(std::vector<ScreenSession::Shown> shown) const;
    terminal::SplitScreen splitScreen();
    void switchSafe();
    bool mayGoOn(const std::function<void()>& tell);
    void waitForKey();
    void readKey();
    void noteTyping(const terminal::KeyEvent& key);
    void needsDisplay();
    void display();
    void keepTurning();
    void adoptSize();

    bool _isDisplayPosted = false;
    terminal::CursesTerminal& _terminal;
    AsioMainQueue _queue;
    DescriptorWatch _keys;
    const terminal::Marks _marks;
    const ScreenSession::Screen _screen;
    const Sessions _sessions;
    bool _isSafe = false; ///< by a key
    terminal::SplitScreen _split;
    std::optional<std::chrono::steady_clock::time_point> _workBegan; ///< since the latest key
    std::chrono::steady_clock::time_point _lookedForKey;
    std::deque<terminal::KeyEvent> _typedAhead;   ///< keys that came during work
    bool _isTypingOn = false;                     ///< another character waits after the latest
    std::chrono::steady_clock::time_point _shown; ///< when the screen was drawn
    std::unique_ptr<RepeatingTimer> _turning;     // while something on the screen turns
};

} // namespace pallax
