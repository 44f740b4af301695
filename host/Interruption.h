#pragma once

#include <chrono>

namespace pallax {

/// Lets a signal that ends the program (SIGINT, SIGTERM, SIGHUP, SIGQUIT) reach a program that is
/// blocked on its own output: a full pipe, or a terminal stopped with Ctrl-S. The main queue, which
/// handles the signal, does not run during the blocked write.
///
/// Half a second after the first such signal, each blocked system call fails with EINTR,
/// repeatedly, until the program has ended. Code that retries interrupted calls must check `isDue`
/// first. After SIGQUIT, the program finally dies of it.
///
/// One at a time, from before the main queue until after the last output.
class Interruption {
public:
    struct Patience {
        /// Output accepted before this is written as usual.
        std::chrono::milliseconds untilDue;
        /// After this time, SIGQUIT kills the program wherever it is.
        std::chrono::milliseconds untilDeath;
    };
    static constexpr Patience kPatience{std::chrono::milliseconds(500),
                                        std::chrono::milliseconds(3000)};

    /// What the signal handlers do to the terminal; must be safe in a signal handler.
    struct Terminal {
        void (*release)(); ///< unblocks pending output
        void (*restore)(); ///< restores the terminal
    };

    explicit Interruption(Terminal terminal = {nullptr, nullptr}, Patience patience = kPatience);
    /// Dies of SIGQUIT if that was the signal.
    ~Interruption();
    Interruption(const Interruption&) = delete;
    Interruption& operator=(const Interruption&) = delete;

    /// Call this once the signal's handler is installed; the handler still receives the signal.
    /// Does nothing for other signals, or without an Interruption.
    static void watch(int signal);
    /// The first of those signals received; 0 if none.
    static int signal();
    /// Whether interrupted calls must give up.
    static bool isDue();
};

} // namespace pallax
