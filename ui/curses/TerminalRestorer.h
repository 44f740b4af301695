#pragma once

#include <string_view>

namespace pallax::terminal {

/// Restores the terminal when a signal kills the process (a crash, an abort, Ctrl-\), and then lets
/// it die. One at a time; the destructor resets the signals to their default actions.
class TerminalRestorer {
public:
    /// `descriptor` is the terminal in its original state.
    explicit TerminalRestorer(int descriptor);
    ~TerminalRestorer();
    TerminalRestorer(const TerminalRestorer&) = delete;
    TerminalRestorer& operator=(const TerminalRestorer&) = delete;

    /// The bytes to write to the terminal; none at first.
    void setSequence(std::string_view sequence);

    /// From now on SIGINT, SIGTERM, SIGHUP and SIGQUIT also restore the terminal and end the
    /// process, until others handle them.
    static void guardEndings();

    /// Both are safe in a signal handler, and do nothing without a restorer. Unblocks output that
    /// Ctrl-S, or a terminal that accepts nothing, holds back; discards the output waiting there.
    static void release();
    /// Restores the terminal, even if Ctrl-S has stopped it.
    static void restore();
};

} // namespace pallax::terminal
