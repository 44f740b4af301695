#include "querying/Interrupt.h"

namespace pallax {

namespace {

volatile std::sig_atomic_t interruptHasCome = 0; // NOLINT(*-avoid-non-const-global-variables)

} // namespace

Interrupt::Interrupt(Watched watched) : _isWatched(watched == Watched::Yes) {
    if (!_isWatched) {
        return;
    }
    interruptHasCome = 0;
    struct sigaction action {};
    action.sa_handler = [](int /*signal*/) { interruptHasCome = 1; };
    (void)::sigaction(SIGINT, &action, &_before); // calls that wait are interrupted, too
}

Interrupt::~Interrupt() {
    if (_isWatched) {
        (void)::sigaction(SIGINT, &_before, nullptr);
    }
}

bool Interrupt::hasCome() const {
    return _isWatched && interruptHasCome != 0;
}

} // namespace pallax
