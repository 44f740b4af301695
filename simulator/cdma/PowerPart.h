#pragma once

#include "simulator/Measurement.h"

#include <cmath>

namespace pallax::cdma {

/// A pilot's share of the received power, in 512ths.
inline unsigned rawPart(double part_db) {
    constexpr double kWhole = 512;
    return rawOf(kWhole * std::pow(10.0, part_db / 10), 0, 1, 16);
}

} // namespace pallax::cdma
