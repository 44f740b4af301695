#pragma once

#include <cstdint>

namespace pallax {

/// The one lock around the display's arrays: recursive, with a depth counter.
///
/// A thread that nests it twice releases the lock only once after two unlocks, and keeps holding
/// it one level deep; this is the required behaviour of the pair.
class ArrayLock {
public:
    /// Acquires the lock, then adds 1 to the depth.
    static void lockArray();
    /// Subtracts 1 from the depth (8 bits, wrapping), and releases the lock when that is then 0.
    static void unlockArray();
    /// For tests.
    static std::uint8_t depth();
};

} // namespace pallax
