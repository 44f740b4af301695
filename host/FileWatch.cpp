#include "host/FileWatch.h"

#include "text/Format.h"

#include <sys/stat.h>
#include <utility>

namespace pallax {

std::uint64_t sizeOfFile(const std::string& path) {
    struct stat status {};
    return ::stat(path.c_str(), &status) == 0 ? static_cast<std::uint64_t>(status.st_size) : 0;
}

FileWatch::FileWatch(std::string path)
    : _path(std::move(path)), _identity(regularFile(_path)), _size(sizeOfFile(_path)) {}

bool FileWatch::isSameFile() const {
    return regularFile(_path) == _identity;
}

std::optional<std::string> FileWatch::trouble(std::uint64_t read) const {
    if (!_identity) {
        return std::nullopt;
    }
    if (!isSameFile()) {
        return formatText("%@ was replaced or removed while it was read.", {_path});
    }
    const std::uint64_t size = sizeOfFile(_path);
    if (size < _size || size < read) {
        return formatText("%@ has become shorter while it was read.", {_path});
    }
    return size > _size ? std::optional(formatText("%@ has grown while it was read.", {_path}))
                        : std::nullopt;
}

} // namespace pallax
