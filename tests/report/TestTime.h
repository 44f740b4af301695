#pragma once

#include "text/Date.h"

namespace pallax {

/// So many seconds after the start.
inline Time at(int second) {
    return Time(std::chrono::seconds(1'700'000'000 + second));
}

} // namespace pallax
