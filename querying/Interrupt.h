#pragma once

#include <csignal>

namespace pallax {

/// Takes Ctrl-C (SIGINT) for as long as it lives, so that it ends what runs and not the program.
/// They nest: each begins without one, and the innermost takes it.
class Interrupt {
public:
    enum class Watched { No, Yes };

    explicit Interrupt(Watched watched);
    ~Interrupt();
    Interrupt(const Interrupt&) = delete;
    Interrupt& operator=(const Interrupt&) = delete;

    bool hasCome() const;

private:
    bool _isWatched;
    struct sigaction _before {};
};

} // namespace pallax
