#pragma once

#include <chrono>

namespace pallax {

/// Lets a signal that asks the program to end (SIGINT, SIGTERM, SIGHUP, SIGQUIT) reach a program
/// that waits for its own output: in a pipe that nobody empties, or on a terminal that Ctrl-S has
/// stopped. The main queue, which handles the signal, does not run meanwhile.
///
/// When the program has not ended half a second after the first such signal, each of its blocked
/// system calls fails with EINTR, again and again, until it has. Whoever repeats an interrupted
/// call asks `isDue` first. A program that SIGQUIT has asked dies of it at the end.
///
/// One at a time, from before the main queue until after the last output.
class Interruption {
public:
    struct Patience {
        /// What is taken by then is written as without the signal.
        std::chrono::milliseconds untilDue;
        /// A program that SIGQUIT has not ended by then dies of it wherever it is.
        std::chrono::milliseconds untilDeath;
    };
    static constexpr Patience kPatience{std::chrono::milliseconds(500),
                                        std::chrono::milliseconds(3000)};

    /// What the signal handlers do to the terminal that is drawn on; safe in a signal handler.
    struct Terminal {
        void (*release)(); ///< lets output go on that is held back
        void (*restore)(); ///< leaves the terminal as it was
    };

    explicit Interruption(Terminal terminal = {nullptr, nullptr}, Patience patience = kPatience);
    /// Dies of SIGQUIT where that is the signal.
    ~Interruption();
    Interruption(const Interruption&) = delete;
    Interruption& operator=(const Interruption&) = delete;

    /// To be called once the signal's handler is installed, which goes on hearing of it. Does
    /// nothing for other signals, nor while no Interruption lives.
    static void watch(int signal);
    /// The first of those signals that has come; 0 when none has.
    static int signal();
    /// Whether interrupted calls are given up.
    static bool isDue();
};

} // namespace pallax
