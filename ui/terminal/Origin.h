#pragma once

#include "ui/terminal/Marks.h"

#include <string>
#include <string_view>

namespace pallax::terminal {

/// What the values come from: "Zorell_LTE" and "drive.pcap". Either may be unknown, and empty.
struct Origin {
    std::string technology;
    std::string source;
};

/// Both in at most so many columns. A source that does not fit loses its beginning, then all of it;
/// where not even the technology fits, the text is empty.
std::string originText(const Origin& origin, const Marks& marks, int columns);

/// Says that the values are from before `time`, which a restarted link has left behind, and which
/// key starts afresh; in at most so many columns, where that is possible.
std::string oldValuesText(std::string_view time, int columns);

} // namespace pallax::terminal
