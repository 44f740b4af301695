#pragma once

#include "tests/doubles/Files.h"

#include <cstddef>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <string_view>

namespace pallax::doubles {

/// A temporary folder for files and, as $XDG_RUNTIME_DIR, for sockets.
class RuntimeFolder {
public:
    RuntimeFolder() { (void)::setenv("XDG_RUNTIME_DIR", path().c_str(), 1); }
    ~RuntimeFolder() { (void)::unsetenv("XDG_RUNTIME_DIR"); }
    RuntimeFolder(const RuntimeFolder&) = delete;
    RuntimeFolder& operator=(const RuntimeFolder&) = delete;

    std::string path() const { return _folder.path(); }
    std::string file(std::string_view name) const { return _folder.path(name); }
    std::string write(std::string_view name, std::string_view content) const {
        return _folder.write(name, content);
    }
    /// The current number of sockets in it.
    std::size_t socketCount() const {
        std::size_t count = 0;
        for (const auto& entry : std::filesystem::recursive_directory_iterator(path())) {
            count += entry.is_socket() ? 1U : 0U;
        }
        return count;
    }

private:
    TemporaryFolder _folder;
};

} // namespace pallax::doubles
