#include "LogGenerator/Records/ArrayLock.h"

#include <mutex>

namespace pallax {

namespace {

std::recursive_mutex& lock() {
    // Never destroyed: a thread may hold it until the process ends.
    static auto* mutex = new std::recursive_mutex;
    return *mutex;
}

std::uint8_t lockDepth = 0; // guarded by the lock

} // namespace

void ArrayLock::lockArray() {
    lock().lock();
    ++lockDepth;
}

void ArrayLock::unlockArray() {
    --lockDepth;
    if (lockDepth == 0) {
        lock().unlock();
    }
}

std::uint8_t ArrayLock::depth() {
    return lockDepth;
}

} // namespace pallax
