#pragma once

#include "tests/cli/PallaxProcess.h"
#include "tests/cli/TerminalScreen.h"

#include <functional>
#include <string>
#include <sys/types.h>
#include <vector>

namespace pallax::doubles {

/// A program that runs in a pseudo-terminal of its own: keys go in, and what a user would see is
/// read from an emulated screen.
class PallaxTerminal {
public:
    struct Setup {
        int columns = 80;
        int rows = 24;
        std::string type = "xterm-256color"; ///< TERM
        std::string locale = "C.UTF-8";
        std::string program{}; ///< the real `pallax` when empty
    };

    PallaxTerminal(const World& world, std::vector<std::string> arguments, const Setup& setup);
    /// Kills it if it still runs.
    ~PallaxTerminal();
    PallaxTerminal(const PallaxTerminal&) = delete;
    PallaxTerminal& operator=(const PallaxTerminal&) = delete;

    void type(const std::string& keys) const;
    void resize(int columns, int rows);
    void signal(int number) const;
    /// While it runs.
    pid_t id() const { return _process; }

    /// True once the screen shows the text; false, with a test failure that shows the screen,
    /// when it does not within ten seconds.
    bool shows(const std::string& text);
    /// True once the screen no longer shows the text; as `shows` otherwise.
    bool showsNoMore(const std::string& text);
    /// The screen as it is once nothing more has come for a moment.
    std::string settled();
    /// As PallaxProcess's; what is written until the end is read.
    int wait();

    const TerminalScreen& screen() const { return _screen; }
    /// All bytes that came so far.
    const std::string& bytes() const { return _bytes; }
    /// Whether the terminal is as a shell leaves it: lines and echo, as at the start.
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
