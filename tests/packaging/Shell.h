#pragma once

#include <filesystem>
#include <string>

namespace pallax::doubles {

/// A folder of its own, removed at the end.
class TemporaryFolder {
public:
    TemporaryFolder();
    ~TemporaryFolder();
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    std::string path(const std::string& name = "") const { return (_folder / name).string(); }
    /// Writes a file into it; its path.
    std::string write(const std::string& name, const std::string& content) const;

private:
    std::filesystem::path _folder;
};

struct CommandRun {
    int status;
    std::string out; ///< standard output and error
};

/// Runs a command as sh takes it.
CommandRun runCommand(const std::string& command);

/// True where a program of that name can be started.
bool isInstalled(const std::string& program);

std::string contentOf(const std::filesystem::path& path);

} // namespace pallax::doubles
