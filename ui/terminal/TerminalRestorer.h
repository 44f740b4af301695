#pragma once

#include <string_view>

namespace pallax::terminal {

/// Restores the terminal when the process dies of a signal (a crash, an abort, Ctrl-\), and then
/// lets it die of it. One at a time; the destructor gives the signals their default actions.
class TerminalRestorer {
public:
    /// `descriptor` is the terminal, as it was before anything was drawn.
    explicit TerminalRestorer(int descriptor);
    ~TerminalRestorer();
    TerminalRestorer(const TerminalRestorer&) = delete;
    TerminalRestorer& operator=(const TerminalRestorer&) = delete;

    /// What is written to the terminal; nothing at first.
    void setSequence(std::string_view sequence);

    /// From here on SIGINT, SIGTERM, SIGHUP and SIGQUIT restore the terminal and end the process
    /// too, until others handle them.
    static void guardEndings();

    /// Both are safe in a signal handler, and do nothing while there is no restorer. Lets output go
    /// on that Ctrl-S, or a terminal that takes nothing, holds back; what waits there is dropped.
    static void release();
    /// Restores the terminal, also one that Ctrl-S has stopped.
    static void restore();
};

} // namespace pallax::terminal
