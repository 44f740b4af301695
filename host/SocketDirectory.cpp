#include "host/SocketDirectory.h"

#include "host/FileName.h"
#include "host/UnixSocket.h"
#include "platform/Format.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <sys/file.h>
#include <sys/stat.h>

namespace pallax {

namespace {

std::string placeOfDirectory() {
    const char* runtime = std::getenv("XDG_RUNTIME_DIR"); // NOLINT(concurrency-mt-unsafe)
    if (runtime != nullptr && *runtime == '/') {
        return std::string(runtime) + "/pallax";
    }
    return formatText("/tmp/pallax-%u", {::geteuid()});
}

HostError refusal(const std::string& path, std::string_view why) {
    return {formatText("The folder for message ports, %@, %@.", {path, why})};
}

} // namespace

Result<SocketDirectory, HostError> SocketDirectory::open() {
    const std::string path = placeOfDirectory();
    if (::mkdir(path.c_str(), S_IRWXU) != 0 && errno != EEXIST) {
        return refusal(path, formatText("cannot be made: %@", {std::strerror(errno)}));
    }
    struct stat status {};
    if (::lstat(path.c_str(), &status) != 0) {
        return refusal(path, formatText("cannot be looked at: %@", {std::strerror(errno)}));
    }
    if (S_ISLNK(status.st_mode)) {
        return refusal(path, "is a symbolic link");
    }
    if (!S_ISDIR(status.st_mode)) {
        return refusal(path, "is no folder");
    }
    if (status.st_uid != ::geteuid()) {
        return refusal(path, "belongs to another user");
    }
    if ((status.st_mode & (S_IRWXG | S_IRWXO)) != 0) {
        return refusal(path, "can be entered by other users (its mode must be 0700)");
    }
    return SocketDirectory(path);
}

Result<std::string, HostError> SocketDirectory::socketPath(std::string_view name) const {
    if (name.empty()) {
        return HostError{"A message port needs a name."};
    }
    std::string path = _path + "/" + fileNameFor(name);
    if (path.size() > longestSocketPath()) {
        return HostError{formatText("The name of the message port %@ is too long: its socket's "
                                    "path would have %zu bytes, and %zu is the most.",
                                    {name, path.size(), longestSocketPath()})};
    }
    return path;
}

Descriptor SocketDirectory::lock() const {
    Descriptor folder(::open(_path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    int locked = -1;
    while (folder && (locked = ::flock(folder.number(), LOCK_EX)) != 0 && errno == EINTR) {
    }
    return locked == 0 ? std::move(folder) : Descriptor();
}

void SocketDirectory::removeStaleSockets() const {
    const Descriptor held = lock();
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(_path, error)) {
        const std::string& path = entry.path().native();
        if (held && entry.is_socket(error) && listenerAt(path) == Listener::Stale) {
            (void)::unlink(path.c_str());
        }
    }
}

} // namespace pallax
