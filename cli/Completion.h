#pragma once

#include "cli/CommandDescription.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The shells with a completion script.
std::vector<std::string> completionShells();

/// The script with which a shell completes the program's command line: commands, options, their
/// choices, and files. Empty for an unknown shell.
std::string completionScript(const CommandDescription& program, std::string_view shell);

/// The name of the shell function that completes the program's command line.
std::string completionFunction(const CommandDescription& program);

std::string bashCompletion(const CommandDescription& program);
std::string zshCompletion(const CommandDescription& program);
std::string fishCompletion(const CommandDescription& program);

} // namespace pallax
