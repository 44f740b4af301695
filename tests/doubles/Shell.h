#pragma once

#include <string>

namespace pallax::doubles {

struct CommandRun {
    int status;
    std::string out; ///< standard output and error
};

/// Runs a command with sh.
CommandRun runCommand(const std::string& command);

/// True if a program with this name can be started.
bool isInstalled(const std::string& program);

} // namespace pallax::doubles
