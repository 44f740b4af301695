#pragma once

#include "text/Date.h"

#include <string>
#include <string_view>

namespace pallax {

class Clock;

struct EventLine {
    std::string_view recording; ///< its name; empty if the line does not tell it
    Time time;
    std::string_view kind;
    std::string_view words;
};

/// Appends "a.pcap: 2023-11-14 23:13:20.000  cell-change       serving cell 150 → 182": the name of
/// the recording, local time, kind and words, in one line that is safe for terminals.
void appendEventLine(std::string& text, const EventLine& line, const Clock& zone);

} // namespace pallax
