#pragma once

#include "simulator/Random.h"

#include <algorithm>
#include <cmath>

namespace pallax {

/// A value as the phone measures it: with a little noise, which has a bound.
inline double measured(double value, double noise, Random& random) {
    return value + random.normal() * noise;
}

/// The raw number that stands for `value` in steps of `step` above `least`, kept within `bits`
/// bits.
inline unsigned rawOf(double value, double least, double step, unsigned bits) {
    const double largest = static_cast<double>((1ULL << bits) - 1);
    return static_cast<unsigned>(
        std::clamp(std::floor((value - least) / step + 0.5), 0.0, largest));
}

/// To the nearest whole number.
inline int whole(double value) {
    return static_cast<int>(std::floor(value + 0.5));
}

} // namespace pallax
