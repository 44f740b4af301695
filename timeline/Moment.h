#pragma once

#include <cstdint>

namespace pallax {

class Timeline;

/// An instant of a timeline, which a screen shows.
struct Moment {
    Timeline* timeline = nullptr; ///< null: no packet has come
    std::uint64_t instant = 0;    ///< as for Timeline
};

} // namespace pallax
