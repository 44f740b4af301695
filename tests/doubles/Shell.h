#pragma once

#include <string>

namespace pallax::doubles {

struct CommandRun {
    int status;
    std::string out; ///< standard output and error
};

/// Runs a command as sh takes it.
CommandRun runCommand(const std::string& command);

/// True where a program of that name can be started.
bool isInstalled(const std::string& program);

} // namespace pallax::doubles
