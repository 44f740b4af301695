#pragma once

#include "cli/CommandDescription.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The shells that there is a completion script for.
std::vector<std::string> completionShells();

/// The script that makes a shell complete the program's command line: commands, options, their
/// choices, and files where a file is taken. Empty for a shell that is unknown.
std::string completionScript(const CommandDescription& program, std::string_view shell);

std::string bashCompletion(const CommandDescription& program);
std::string zshCompletion(const CommandDescription& program);
std::string fishCompletion(const CommandDescription& program);

} // namespace pallax
