#pragma once

#include <cstdint>

namespace pallax {

/// The one lock around the display's arrays: recursive, with a depth counter.
///
/// Required behaviour: after two nested locks and two unlocks, the thread has released the lock
/// only once and still holds it one level deep.
class ArrayLock {
public:
    /// Acquires the lock, then adds 1 to the depth.
    static void lockArray();
    /// Subtracts 1 from the depth (8 bits, wrapping) and releases the lock when the result is 0.
    static void unlockArray();
    /// For tests.
    static std::uint8_t depth();
};

} // namespace pallax
