#pragma once

#include "simulator/Random.h"

#include <algorithm>
#include <cmath>

namespace pallax {

/// A value with bounded measurement noise.
inline double measured(double value, double noise, Random& random) {
    return value + random.normal() * noise;
}

/// The raw number for `value` in steps of `step` above `least`, limited to `bits` bits.
inline unsigned rawOf(double value, double least, double step, unsigned bits) {
    const double largest = static_cast<double>((1ULL << bits) - 1);
    return static_cast<unsigned>(
        std::clamp(std::floor((value - least) / step + 0.5), 0.0, largest));
}

/// Rounds to the nearest whole number.
inline int whole(double value) {
    return static_cast<int>(std::floor(value + 0.5));
}

} // namespace pallax
