#pragma once

#include <string_view>

/// Messages on standard error. They may contain file names, settings and texts of other processes,
/// so they are always escaped as for a terminal.
namespace pallax {

/// Prints "pallax: " and the sentence, in one line.
void complain(std::string_view sentence);

/// Prints lines that already start with the program's name.
void passOnComplaints(std::string_view lines);

} // namespace pallax
