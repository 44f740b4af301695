#pragma once

#include "platform/MainQueue.h"

#include <functional>
#include <string>
#include <vector>

namespace pallax {

/// Runs a program beside this one, without waiting. `ended` is called as a block of the queue, with
/// what it wrote to standard error ("" if it was successful); never, if the queue ends before.
void runBeside(MainQueue& queue, const std::vector<std::string>& words,
               const std::function<void(const std::string& complaint)>& ended);

/// This program, and the one for terminals beside it.
std::string windowProgram();
std::string terminalProgram();

} // namespace pallax
