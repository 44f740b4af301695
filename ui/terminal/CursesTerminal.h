#pragma once

#include "text/Result.h"
#include "ui/terminal/Grid.h"
#include "ui/terminal/Keys.h"
#include "ui/terminal/Marks.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax::terminal {

enum class ColorUse { Auto, Always, Never };

/// Why there is no terminal; one clear sentence.
struct TerminalError {
    std::string sentence;
};

/// The terminal that the process runs in, as long as this exists; its destruction restores it.
/// Only one at a time. All of its output goes through the curses library.
class CursesTerminal {
public:
    struct Options {
        ColorUse color = ColorUse::Auto; ///< Auto: unless NO_COLOR is set
        bool mouse = true;
    };

    /// Keys come from the controlling terminal, so standard input may be something else.
    static Result<std::unique_ptr<CursesTerminal>, TerminalError> open(const Options& options);
    /// Whether this process may draw at all: standard output is a terminal that can be drawn on.
    static bool isPossible();

    ~CursesTerminal();
    CursesTerminal(const CursesTerminal&) = delete;
    CursesTerminal& operator=(const CursesTerminal&) = delete;

    int columns() const;
    int rows() const;
    /// ASCII only, unless the user's locale is UTF-8's.
    const Marks& marks() const;
    /// Readable when a key may be waiting.
    int inputDescriptor() const;

    /// To be called when the extent may have changed.
    void adoptSize();
    void show(const Grid& grid);
    /// What is really on the screen is unknown: the next `show` draws all of it.
    void repaint();
    /// The next key; nothing when none is waiting.
    std::optional<KeyEvent> read();
    /// Whether nobody is at the other end any more.
    bool isHungUp() const;
    /// Puts a text into the clipboard of the terminal that the user sits at (OSC 52).
    void copy(std::string_view text);

private:
    struct Impl;
    explicit CursesTerminal(std::unique_ptr<Impl> impl);
    std::unique_ptr<Impl> _impl;
};

} // namespace pallax::terminal
