#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace pallax::doubles {

/// The whole content of a file; empty, with a failed expectation, if it cannot be read.
std::string contentOf(const std::filesystem::path& path);

/// A new folder with a short path (for sockets). It is removed with its content at the end.
class TemporaryFolder {
public:
    TemporaryFolder();
    ~TemporaryFolder();
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    std::string path() const { return _folder.string(); }
    std::string path(std::string_view name) const { return (_folder / name).string(); }
    /// Writes a file into it and returns its path.
    std::string write(std::string_view name, std::string_view content) const;

private:
    std::filesystem::path _folder;
};

} // namespace pallax::doubles
