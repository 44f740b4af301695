#pragma once

#include <optional>
#include <string>
#include <sys/stat.h>

namespace pallax {

/// Identifies a file independently of its names.
struct FileIdentity {
    dev_t device = 0;
    ino_t inode = 0;
    friend bool operator==(const FileIdentity&, const FileIdentity&) = default;
};

inline FileIdentity identityOf(const struct stat& status) {
    return {status.st_dev, status.st_ino};
}

/// Nothing for what is no regular file, or cannot be looked at.
std::optional<FileIdentity> regularFile(int descriptor);
/// The file to which the path leads.
std::optional<FileIdentity> regularFile(const std::string& path);

} // namespace pallax
