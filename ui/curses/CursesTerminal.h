#pragma once

#include "text/Result.h"
#include "ui/drawing/Grid.h"
#include "ui/drawing/Keys.h"
#include "ui/drawing/Marks.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax::terminal {

enum class ColorUse { Auto, Always, Never };

/// Why there is no terminal, in one sentence.
struct TerminalError {
    std::string sentence;
};

/// The terminal that the process runs in; the destructor restores it. Only one at a time. All of
/// its output goes through the curses library.
class CursesTerminal {
public:
    struct Options {
        ColorUse color = ColorUse::Auto; ///< Auto: colours unless NO_COLOR is set
        bool mouse = true;
    };

    /// Keys come from the controlling terminal, so standard input is free for other uses.
    static Result<std::unique_ptr<CursesTerminal>, TerminalError> open(const Options& options);
    /// Whether standard output is a terminal that can be drawn on.
    static bool isPossible();

    ~CursesTerminal();
    CursesTerminal(const CursesTerminal&) = delete;
    CursesTerminal& operator=(const CursesTerminal&) = delete;

    int columns() const;
    int rows() const;
    /// ASCII unless the user's locale is UTF-8; without braille on the kernel's console, whose
    /// fonts have at most 512 characters.
    const Marks& marks() const;
    /// Readable when a key may be waiting.
    int inputDescriptor() const;

    /// Call this when the extent may have changed, and after the program was suspended.
    void adoptSize();
    void show(const Grid& grid);
    /// The contents of the screen are unknown: the next `show` draws all of it.
    void repaint();
    /// The next key; nothing when none is waiting. Of a drag, only the latest position.
    std::optional<KeyEvent> read();
    /// Whether the other end of the terminal has gone.
    bool isHungUp() const;
    void ringBell();
    /// Puts a text into the clipboard of the user's terminal (OSC 52).
    void copy(std::string_view text);

private:
    struct Impl;
    explicit CursesTerminal(std::unique_ptr<Impl> impl);
    static std::optional<KeyEvent> readOne();
    std::unique_ptr<Impl> _impl;
};

} // namespace pallax::terminal
