#pragma once

#include "timeline/Timeline.h"

#include <optional>

namespace pallax {

/// The packet and the row of a layout from which a value was read.
struct Reading {
    std::uint64_t packet = 0;
    FieldId row = 0;
    Field layout; ///< its texts live as long as the program; without a key
};

/// The last reading of a field at that time, up to an instant; of a field in lists, that of its
/// list. Nothing if there is none. Decodes from the nearest key frame.
std::optional<Reading> readingAt(Timeline& timeline, FieldIndex field, Time time,
                                 std::uint64_t instant);

} // namespace pallax
