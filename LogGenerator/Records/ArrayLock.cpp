#include "LogGenerator/Records/ArrayLock.h"

#include <mutex>

namespace pallax {

namespace {

struct LockState {
    std::recursive_mutex lock;
    std::uint8_t depth = 0;
};

/// Made when first used and never destroyed: nested pairs leave the lock held until the end of
/// the process, and a held lock must not be destroyed.
LockState& lockState() {
    static auto* const state = new LockState;
    return *state;
}

} // namespace

void ArrayLock::lockArray() {
    LockState& state = lockState();
    state.lock.lock();
    ++state.depth;
}

void ArrayLock::unlockArray() {
    LockState& state = lockState();
    --state.depth;
    if (state.depth == 0) {
        state.lock.unlock();
    }
}

std::uint8_t ArrayLock::depth() {
    return lockState().depth;
}

} // namespace pallax
