#pragma once

#include "host/FileIdentity.h"

#include <cstdint>
#include <optional>
#include <string>

namespace pallax {

/// Notices that a regular file becomes another one, or has another size, while it is read. Of
/// anything else it notices nothing.
class FileWatch {
public:
    explicit FileWatch(std::string path);

    /// One sentence about how the file has changed. `read` bytes were there since.
    std::optional<std::string> trouble(std::uint64_t read = 0) const;
    /// Whether the path still leads to the file.
    bool isSameFile() const;
    /// When the watch began.
    std::uint64_t size() const { return _size; }

private:
    std::string _path;
    std::optional<FileIdentity> _identity; ///< of a regular file
    std::uint64_t _size;
};

/// The size of a file; 0 if there is none.
std::uint64_t sizeOfFile(const std::string& path);

} // namespace pallax
