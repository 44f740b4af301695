#pragma once

#include "platform/MainQueue.h"

#include <functional>
#include <string>
#include <vector>

namespace pallax {

/// Runs a program beside this one, without waiting. `ended` is called as a block of the queue, with
/// what it wrote to standard error ("" if it was successful, or if it was a window that told in a
/// page why it ended); never, if the queue ends before. With a token, it may come to the front.
void runBeside(MainQueue& queue, const std::vector<std::string>& words,
               const std::function<void(const std::string& complaint)>& ended,
               const std::string& token = "");

/// This program, and the one for terminals beside it.
std::string windowProgram();
std::string terminalProgram();

} // namespace pallax
