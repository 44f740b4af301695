#pragma once

#include "fields/EventFields.h"
#include "text/Date.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// Something that happened in a recording.
struct Event {
    EventKind kind = EventKind::CellChange;
    Time time;                       ///< of its packet
    std::uint64_t packet = 0;        ///< that shows it
    std::string words;               ///< "serving cell 182 -> 183 after 31 s"
    std::vector<std::string> fields; ///< the names of the fields that show it
};

} // namespace pallax
