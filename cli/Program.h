#pragma once

#include "console/ExitStatus.h"

#include <functional>
#include <string>
#include <vector>

namespace pallax {

struct ParseEnd;

/// What every program's `main` is: the service of a child process if the arguments ask for one, and
/// otherwise `run` with those after the program's name. Exceptions of `run` become one sentence on
/// standard error and the exit status.
int runProgram(int argc, char** argv,
               const std::function<ExitStatus(std::vector<std::string> arguments)>& run);

/// Writes the text to where it belongs, and returns the status.
ExitStatus tell(const ParseEnd& end);

} // namespace pallax
