#pragma once

#include <string_view>

/// What is told on standard error. File names, settings and what another process sends may stand in
/// it, so it is written as a terminal may get it, wherever it goes.
namespace pallax {

/// "pallax: " and the sentence, in one line.
void complain(std::string_view sentence);

/// Lines that name the program already.
void passOnComplaints(std::string_view lines);

} // namespace pallax
