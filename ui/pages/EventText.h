#pragma once

#include "ui/drawing/Marks.h"

#include <string>

namespace pallax::terminal {

/// Words that may have an arrow, as those of an event, in the characters of the terminal.
std::string eventWords(std::string words, const Marks& marks);

} // namespace pallax::terminal
