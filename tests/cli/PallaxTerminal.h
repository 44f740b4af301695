#pragma once

#include "tests/cli/PallaxProcess.h"
#include "tests/cli/TerminalScreen.h"

#include <functional>
#include <string>
#include <sys/types.h>
#include <vector>

namespace pallax::doubles {

/// A program in its own pseudo-terminal: the test types keys and reads an emulated screen, as a
/// user would.
class PallaxTerminal {
public:
    struct Setup {
        int columns = 80;
        int rows = 24;
        std::string type = "xterm-256color"; ///< TERM
        std::string locale = "C.UTF-8";
        std::string program{}; ///< empty: the real `pallax`
    };

    PallaxTerminal(const World& world, std::vector<std::string> arguments, const Setup& setup);
    /// Kills it if it still runs.
    ~PallaxTerminal();
    PallaxTerminal(const PallaxTerminal&) = delete;
    PallaxTerminal& operator=(const PallaxTerminal&) = delete;

    void type(const std::string& keys) const;
    void resize(int columns, int rows);
    void signal(int number) const;
    /// Valid while it runs.
    pid_t id() const { return _process; }

    /// Waits until the screen shows the text. After ten seconds it returns false and fails the test
    /// with the screen.
    bool shows(const std::string& text);
    /// Waits until the screen no longer shows the text; otherwise like `shows`.
    bool showsNoMore(const std::string& text);
    /// The screen after a moment without output.
    std::string settled();
    /// As PallaxProcess::wait; also reads the output until the end.
    int wait();

    const TerminalScreen& screen() const { return _screen; }
    /// All bytes received so far.
    const std::string& bytes() const { return _bytes; }
    /// Whether lines and echo are on, as at the start.
    bool isRestored() const;

private:
    bool readFor(int milliseconds);
    bool waitUntil(const std::function<bool()>& condition, const std::string& wanted);

    TerminalScreen _screen;
    std::string _bytes;
    int _terminal = -1;
    pid_t _process = -1;
    bool _isClosed = false;
};

} // namespace pallax::doubles
