#pragma once

#include <cstdint>

namespace pallax {

/// The lock around the arrays of the live display: taken by records while they empty and refill
/// one, and by the display tree while it walks one. Process-wide and recursive.
///
/// The lock is released only when the depth is back at zero, so that a thread that nests two
/// pairs keeps holding it one level deep: whoever nests pairs stays alone with the arrays.
class ArrayLock {
public:
    /// Acquires the lock, then adds 1 to the depth.
    static void lockArray();
    /// Subtracts 1 from the depth; releases the lock once only when the depth is then 0.
    static void unlockArray();
    /// How deep the holder is nested, in 8 bits. For tests, on the thread that holds the lock or
    /// while none does.
    static std::uint8_t depth();
};

} // namespace pallax
