#pragma once

#include "text/Date.h"
#include "ui/drawing/Marks.h"

#include <chrono>
#include <string>

namespace pallax::terminal {

/// The time of day of an event: "22:14:06", so much ahead of UTC.
std::string eventTime(Time time, std::chrono::seconds ahead);

/// Words that may have an arrow, as those of an event, in the characters of the terminal.
std::string eventWords(std::string words, const Marks& marks);

} // namespace pallax::terminal
