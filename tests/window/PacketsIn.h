#pragma once

#include "host/Recording.h"

#include <cstddef>
#include <string>

namespace pallax::doubles {

/// How many packets a recording has, until its end or its damage.
inline std::size_t packetsIn(const std::string& path) {
    const auto recording = Recording::open(path);
    std::size_t count = 0;
    while (recording && (*recording)->next()) {
        ++count;
    }
    return count;
}

} // namespace pallax::doubles
