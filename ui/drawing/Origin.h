#pragma once

#include "ui/drawing/Marks.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {

/// The origin of the values: "Zorell_LTE" and "drive.pcap". Either may be empty if unknown.
struct Origin {
    std::string technology;
    std::string source;
};

/// Both in at most `columns` columns. A source that does not fit is cut at its beginning or
/// omitted; if not even the technology fits, the text is empty.
std::string originText(const Origin& origin, const Marks& marks, int columns);

/// "! weak signal, no service", or how many there are if the names take more than `columns`
/// columns; empty without alarms.
std::string alarmText(const std::vector<std::string>& names, int columns);

/// Says that the values are from before `time`, after a restart of the link, and which key starts
/// afresh; in at most `columns` columns if possible.
std::string oldValuesText(std::string_view time, int columns);

} // namespace pallax::terminal
